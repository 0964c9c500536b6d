#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>

#include "ViewerTest.h"
#include "ZQVPictureGate.h"

namespace {

std::string bytes(std::initializer_list<int> values) {
  std::string text;
  for (int value : values) text += static_cast<char>(value);
  return text;
}
std::string big32(uint32_t n) {
  return bytes({int(n >> 24), int(n >> 16), int(n >> 8), int(n)});
}
std::string big16(uint32_t n) {
  return bytes({int(n >> 8), int(n)});
}
std::string little16(uint32_t n) {
  return bytes({int(n), int(n >> 8)});
}
std::string little32(uint32_t n) {
  return little16(n) + little16(n >> 16);
}

std::string png(uint32_t width, uint32_t height) {
  return "\x89PNG\r\n\x1a\n" + big32(13) + "IHDR" + big32(width) + big32(height) +
         std::string(20, '\0');
}
std::string gif(uint32_t width, uint32_t height) {
  return "GIF89a" + little16(width) + little16(height) + std::string(20, '\0');
}
std::string bmp(uint32_t width, uint32_t height) {
  return "BM" + std::string(12, '\0') + little32(40) + little32(width) + little32(height) +
         std::string(20, '\0');
}
std::string jpeg(uint32_t width, uint32_t height, const std::string& before = "") {
  return "\xff\xd8" + before + "\xff\xc0" + big16(17) + bytes({8}) + big16(height) + big16(width) +
         std::string(20, '\0');
}
std::string webp(const std::string& kind, const std::string& header) {
  return "RIFF" + little32(100) + "WEBP" + kind + little32(50) + header + std::string(20, '\0');
}

class PictureGate : public ViewerTest {
 protected:
  void SetUp() override {
    ViewerTest::SetUp();
    char name[] = "/tmp/picturegate.XXXXXX";
    folder = mkdtemp(name);
  }
  void TearDown() override { std::filesystem::remove_all(folder); }

  std::string file(const std::string& content) const {
    std::string path = folder + "/picture";
    std::ofstream(path, std::ios::binary) << content;
    return path;
  }
  bool passes(const std::string& content, ZQVPictureGate::Use use = ZQVPictureGate::Thumbnail) {
    return ZQVPictureGate::passes(file(content).c_str(), use);
  }

  std::string folder;
};

TEST_F(PictureGate, OpensForEveryKindOfPictureUpToItsLimits) {
  EXPECT_TRUE(passes(png(1, 1)));
  EXPECT_TRUE(passes(png(8192, 4882)));
  EXPECT_TRUE(passes(gif(640, 480)));
  EXPECT_TRUE(passes(bmp(640, static_cast<uint32_t>(-480))));
  EXPECT_TRUE(passes(jpeg(4000, 3000)));
  EXPECT_TRUE(passes(webp("VP8 ", std::string(6, '\0') + little16(640) + little16(480))));
  EXPECT_TRUE(passes(webp("VP8L", bytes({0x2f}) + little32(639 | 479 << 14))));
  EXPECT_TRUE(passes(webp("VP8X", std::string(4, '\0') + bytes({1, 2, 0, 1, 1, 0}))));
  EXPECT_TRUE(errors().empty());
}

TEST_F(PictureGate, StaysShutForATooLongSide) {
  EXPECT_FALSE(passes(png(8193, 1)));
  EXPECT_FALSE(passes(png(1, 8193)));
  EXPECT_FALSE(passes(png(0xffffffff, 0xffffffff)));
  EXPECT_FALSE(passes(jpeg(65535, 100)));
  EXPECT_FALSE(passes(png(32768, 32768), ZQVPictureGate::FullView));
}

TEST_F(PictureGate, StaysShutForTooManyPixels) {
  EXPECT_FALSE(passes(png(8192, 4883)));
  EXPECT_EQ(errors(), Errors({"picture refused, too many pixels: " + folder + "/picture"}));
}

TEST_F(PictureGate, StaysShutForAPictureWithoutASize) {
  EXPECT_FALSE(passes(png(0, 10)));
  EXPECT_FALSE(passes(jpeg(10, 0)));
  EXPECT_FALSE(passes("\xff\xd8\xff\xe0"));
}

TEST_F(PictureGate, LetsLargeJpegPicturesIntoTheFullView) {
  EXPECT_TRUE(passes(jpeg(16000, 12500), ZQVPictureGate::FullView));
  EXPECT_FALSE(passes(jpeg(16000, 12501), ZQVPictureGate::FullView));
  EXPECT_FALSE(passes(jpeg(16000, 2000), ZQVPictureGate::Thumbnail));
}

TEST_F(PictureGate, FindsTheSizeOfAJpegBehindItsNotes) {
  const std::string notes =
      "\xff\xe1" + big16(60002) + std::string(60000, 'x') + "\xff\xff\xfe" + big16(4) + "ab";
  EXPECT_TRUE(passes(jpeg(100, 100, notes)));
  EXPECT_FALSE(passes(jpeg(9000, 100, notes)));
}

TEST_F(PictureGate, DoesNotFollowAJpegForEver) {
  std::string endless;
  for (int i = 0; i < 100000; ++i) endless += "\xff\xe0" + big16(2);
  EXPECT_FALSE(passes(jpeg(10, 10, endless)));
  std::string padding(100000, '\xff');
  EXPECT_FALSE(passes(jpeg(10, 10, padding)));
  EXPECT_FALSE(passes("\xff\xd8\xff\xe0" + std::string(100, '\0')));
}

TEST_F(PictureGate, StaysShutForWhatIsNoPicture) {
  EXPECT_FALSE(passes(""));
  EXPECT_FALSE(passes("x"));
  EXPECT_FALSE(passes("\x89PNG"));
  EXPECT_FALSE(passes("#!/bin/sh\nexit 0\n"));
  EXPECT_FALSE(passes(std::string(100, '\0')));
  EXPECT_EQ(errors()[0], "picture refused, not a known kind of picture: " + folder + "/picture");
}

TEST_F(PictureGate, StaysShutForThumbnailsOfMoreThan8Megabytes) {
  const std::string path = file(png(10, 10));
  std::filesystem::resize_file(path, 8 << 20);
  EXPECT_TRUE(ZQVPictureGate::passes(path.c_str(), ZQVPictureGate::Thumbnail));
  std::filesystem::resize_file(path, (8 << 20) + 1);
  EXPECT_FALSE(ZQVPictureGate::passes(path.c_str(), ZQVPictureGate::Thumbnail));
  EXPECT_TRUE(ZQVPictureGate::passes(path.c_str(), ZQVPictureGate::FullView));
}

TEST_F(PictureGate, StaysShutForWhatIsNoRegularFile) {
  EXPECT_FALSE(ZQVPictureGate::passes(folder.c_str(), ZQVPictureGate::Thumbnail));
  const std::string pipe = folder + "/pipe";
  ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
  EXPECT_FALSE(ZQVPictureGate::passes(pipe.c_str(), ZQVPictureGate::Thumbnail));
  EXPECT_EQ(errors(), Errors({"picture refused, not a regular file: " + folder,
                              "picture refused, not a regular file: " + pipe}));
}

TEST_F(PictureGate, StaysShutForARelativePath) {
  EXPECT_FALSE(ZQVPictureGate::passes("picture.png", ZQVPictureGate::Thumbnail));
  EXPECT_EQ(errors(), Errors({"picture refused, not an absolute path: picture.png"}));
}

TEST_F(PictureGate, KnowsWhichPicturesMayBeDecodedAhead) {
  const auto isLight = [this](const std::string& content) {
    return ZQVPictureGate::isLight(file(content).c_str());
  };
  EXPECT_TRUE(isLight(jpeg(12000, 9000)));
  EXPECT_TRUE(isLight(png(2000, 2000)));
  EXPECT_FALSE(isLight(png(2001, 2000)));
  EXPECT_FALSE(isLight(jpeg(20000, 10001)));
  EXPECT_FALSE(isLight("words"));
  EXPECT_FALSE(ZQVPictureGate::isLight("/nowhere.jpg"));
}

TEST_F(PictureGate, KnowsWhichPicturesTakeLong) {
  const auto isSlow = [this](const std::string& content) {
    return ZQVPictureGate::decodingOf(file(content).c_str()).isSlow;
  };
  EXPECT_TRUE(isSlow(jpeg(4000, 3000)));
  EXPECT_TRUE(isSlow(png(500, 301)));
  EXPECT_FALSE(isSlow(png(500, 300)));
  EXPECT_FALSE(isSlow("words"));
  EXPECT_FALSE(ZQVPictureGate::decodingOf("/nowhere.jpg").isSlow);
}

TEST_F(PictureGate, IsSilentAboutWhatIsNotThere) {
  EXPECT_FALSE(ZQVPictureGate::passes(nullptr, ZQVPictureGate::Thumbnail));
  EXPECT_FALSE(ZQVPictureGate::passes("", ZQVPictureGate::Thumbnail));
  EXPECT_FALSE(ZQVPictureGate::passes("/no/such/file.png", ZQVPictureGate::FullView));
  EXPECT_TRUE(errors().empty());
}

}  // namespace
