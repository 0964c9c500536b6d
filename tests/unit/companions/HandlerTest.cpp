#include <gtest/gtest.h>
#include <mime_handler.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>

#include "../platform/TestPhone.h"

namespace {

constexpr char kJpeg[] = "\xFF\xD8\xFF\xE0\x00\x10JFIF\x00\x01\x01";
constexpr char kPng[] = "\x89PNG\r\n\x1A\n\x00\x00\x00\rIHDR";
constexpr char kPdf[] = "%PDF-1.4\n%\xE2\xE3\xCF\xD3\n";
constexpr char kZip[] = "PK\x03\x04\x14\x00\x00\x00\x08\x00";
constexpr char kElf[] =
    "\x7F"
    "ELF\x02\x01\x01\x00\x00\x00\x00\x00\x00\x00\x00\x00\x03\x00\x3E\x00";

template <std::size_t Size>
std::string bytes(const char (&literal)[Size]) {
  return {literal, Size - 1};
}

class OpenableType : public testing::Test {
 protected:
  OpenableType() { std::filesystem::create_directories(folder); }
  ~OpenableType() override { std::filesystem::remove_all(folder); }

  std::string path(const std::string& name) { return folder + "/" + name; }

  std::string of(const std::string& name, const std::string& content) {
    writeFile(path(name), content);
    return mime::openableType(path(name));
  }

  const std::string folder = TestPhone::root() + "/files";
};

}  // namespace

TEST_F(OpenableType, IsThatOfTheContent) {
  EXPECT_EQ(of("a.jpg", bytes(kJpeg)), "image/jpeg");
  EXPECT_EQ(of("a.pdf", bytes(kPdf)), "application/pdf");
  EXPECT_EQ(of("a.txt", "Just words.\n"), "text/plain");
}

TEST_F(OpenableType, IsNotWhatTheNameClaims) {
  EXPECT_EQ(of("picture.jpg", bytes(kPng)), "image/png");
  EXPECT_EQ(of("picture.png", bytes(kPdf)), "application/pdf");
  EXPECT_EQ(of("picture.jpg", "Just words.\n"), "text/plain");
}

TEST_F(OpenableType, LetsTheNameChooseWithinAContainer) {
  EXPECT_EQ(of("a.docx", bytes(kZip)),
            "application/vnd.openxmlformats-officedocument.wordprocessingml.document");
  EXPECT_EQ(of("a.jpg", bytes(kZip)), "application/zip");
}

TEST_F(OpenableType, IsNoneForWhatRuns) {
  EXPECT_EQ(of("a.jpg", bytes(kElf)), "");
  EXPECT_EQ(of("a.txt", "#!/bin/sh\nrm -rf /\n"), "");
  EXPECT_EQ(of("a.sh", "rm -rf /\n"), "");
  EXPECT_EQ(of("a.py", "print(1)\n"), "");
  EXPECT_EQ(of("a.desktop", "[Desktop Entry]\nType=Application\nExec=sh\n"), "");
  EXPECT_EQ(of("a.txt", "[Desktop Entry]\nType=Application\nExec=sh\n"), "");
}

TEST_F(OpenableType, IsNoneWithAnExecuteBit) {
  writeFile(path("a.jpg"), bytes(kJpeg));
  for (const mode_t bit : {S_IXUSR, S_IXGRP, S_IXOTH}) {
    ASSERT_EQ(chmod(path("a.jpg").c_str(), 0644 | bit), 0);
    EXPECT_EQ(mime::openableType(path("a.jpg")), "");
  }
}

TEST_F(OpenableType, IsNoneForAnythingButAPlainFile) {
  writeFile(path("a.jpg"), bytes(kJpeg));
  ASSERT_EQ(symlink(path("a.jpg").c_str(), path("link.jpg").c_str()), 0);
  ASSERT_EQ(mkfifo(path("fifo.jpg").c_str(), 0644), 0);
  for (const auto& name : {"link.jpg", "fifo.jpg", "missing.jpg", "", "."}) {
    EXPECT_EQ(mime::openableType(path(name)), "") << name;
  }
  EXPECT_EQ(mime::openableType("/dev/zero"), "");
}

TEST_F(OpenableType, IsNoneForNothingAndForNoise) {
  EXPECT_EQ(of("a.jpg", ""), "");
  EXPECT_EQ(of("a.bin", std::string("\x00\x01\x02\xF3\xA4", 5)), "");
}

TEST_F(OpenableType, BearsOddNames) {
  EXPECT_EQ(of("100%s%n\n\"'$(x) \xFF.jpg", bytes(kJpeg)), "image/jpeg");
}

TEST(RequestUri, MeansAPath) {
  EXPECT_EQ(mime::pathOfUri("/a b/%41.jpg"), "/a b/%41.jpg");
  EXPECT_EQ(mime::pathOfUri("file:///a%20b.jpg"), "/a b.jpg");
  EXPECT_EQ(mime::pathOfUri("http://host/a.jpg"), "");
  EXPECT_EQ(mime::pathOfUri("relative.jpg"), "");
  EXPECT_EQ(mime::pathOfUri(""), "");
}

TEST(RequestUri, OfNothingIsNotOpened) {
  EXPECT_FALSE(mime::resolver_can_open(nullptr));
  EXPECT_FALSE(mime::resolver_can_open(""));
  EXPECT_FALSE(mime::resolver_can_open("/"));
}
