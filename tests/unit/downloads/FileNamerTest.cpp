#include "FileNamer.h"

#include <gtest/gtest.h>

using downloads::numberedName;
using downloads::safeName;

namespace {

struct Case {
  const char* name;
  const char* expected;
};

const Case kCases[] = {
    {"photo.jpg", "photo.jpg"},
    {"사진 한 장.jpg", "사진 한 장.jpg"},
    {"100% %s %n.txt", "100% %s %n.txt"},
    {"../../etc/passwd", "_._.._etc_passwd"},
    {"/etc/passwd", "_etc_passwd"},
    {"..\\..\\boot.ini", "_._.._boot.ini"},
    {"..", "_."},
    {".", "_"},
    {"", "file"},
    {"   ", "file"},
    {".bashrc", "_bashrc"},
    {"\xE2\x80\xAE", "file"},
    {"line\nbreak\ttab\x01.txt", "linebreaktab.txt"},
    {"delete\x7F.txt", "delete.txt"},
    {"invoice\xE2\x80\xAEgpj.exe", "invoicegpj.exe"},
    {"left\xE2\x81\xA6right\xE2\x81\xA9.txt", "leftright.txt"},
    {"\xEF\xBB\xBFmark.txt", "mark.txt"},
    {"family \xF0\x9F\x91\xA9\xE2\x80\x8D\xF0\x9F\x91\xA7.png",
     "family \xF0\x9F\x91\xA9\xE2\x80\x8D\xF0\x9F\x91\xA7.png"},
    {"CON", "_CON"},
    {"aux.txt", "_aux.txt"},
    {"com1.tar.gz", "_com1.tar.gz"},
    {"comet.txt", "comet.txt"},
    {"  blanks.txt  ", "blanks.txt"},
    {"broken \xFF.txt", "broken \xEF\xBF\xBD.txt"},
};

}  // namespace

TEST(FileNamer, MakesEveryNameAPlainVisibleFileName) {
  for (const auto& c : kCases) {
    EXPECT_EQ(safeName(c.name), c.expected) << "for " << testing::PrintToString(c.name);
  }
}

TEST(FileNamer, LeavesASafeNameAsItIs) {
  for (const auto& c : kCases) EXPECT_EQ(safeName(c.expected), c.expected);
}

TEST(FileNamer, DropsWhatFollowsANulByte) {
  EXPECT_EQ(safeName(std::string("a\0b.txt", 7)).find('\0'), std::string::npos);
}

TEST(FileNamer, ShortensALongNameToTheLimitAndKeepsItsExtension) {
  const std::string name = safeName(std::string(300, 'a') + ".jpeg");
  EXPECT_EQ(name.size(), 255u);
  EXPECT_EQ(name.substr(250), ".jpeg");
}

TEST(FileNamer, LeavesANameOfExactlyTheLimitAlone) {
  const std::string name = std::string(251, 'a') + ".jpg";
  EXPECT_EQ(safeName(name), name);
}

TEST(FileNamer, NeverCutsACharacterInTwo) {
  std::string letters;
  for (int i = 0; i < 100; i++) letters += "가";
  const std::string name = safeName(letters + ".jpg");
  EXPECT_LE(name.size(), 255u);
  EXPECT_EQ((name.size() - 4) % 3, 0u);
  EXPECT_EQ(name.substr(name.size() - 4), ".jpg");
}

TEST(FileNamer, LeavesNoBlankAtTheEndOfAShortenedName) {
  const std::string name = safeName(std::string(254, 'a') + " b");
  EXPECT_EQ(name, std::string(254, 'a'));
}

TEST(FileNamer, TakesAnEndlessExtensionForPartOfTheName) {
  EXPECT_EQ(safeName("a." + std::string(400, 'b')).size(), 255u);
}

TEST(FileNamer, NumbersAClashBeforeTheExtension) {
  EXPECT_EQ(numberedName("photo.jpg", 0), "photo.jpg");
  EXPECT_EQ(numberedName("photo.jpg", 1), "photo (1).jpg");
  EXPECT_EQ(numberedName("README", 12), "README (12)");
}

TEST(FileNamer, NumbersALongNameWithinTheLimit) {
  const std::string name = numberedName(safeName(std::string(300, 'a') + ".jpg"), 9999);
  EXPECT_EQ(name.size(), 255u);
  EXPECT_EQ(name.substr(244), " (9999).jpg");
}
