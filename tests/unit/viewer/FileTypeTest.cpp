#include "ViewerTest.h"
#include "ZQVCommon.h"

namespace {

class FileType : public ViewerTest {
 protected:
  static int ofName(const char* name) {
    return ZQViewerCommon::getInstance().getFileTypeNum(name, nullptr, 0);
  }
  static int ofExtension(const char* extension) {
    return ZQViewerCommon::getInstance().getFileTypeNum(extension, nullptr, 1);
  }
};

const char* const kTable[] = {
    "mpeg", "mpg", "mp4",  "m4v",  "3gp",  "3gpp", "3g2",  "3gpp2", "mkv",  "webm",  "ts",   "avi",
    "ram",  "rm",  "rmvb", "wmv",  "asf",  "divx", "flv",  "tp",    "trp",  "m2ts",  "mts",  "m2t",
    "smi",  "mp3", "mpga", "m4a",  "wav",  "amr",  "awb",  "3ga",   "wma",  "qcp",   "evc",  "pva",
    "aac",  "pyv", "dm",   "ogg",  "oga",  "mka",  "mid",  "midi",  "xmf",  "rtttl", "smf",  "imy",
    "rtx",  "ota", "mxmf", "m3u",  "pls",  "wpl",  "m3u8", "fl",    "flac", "jpeg",  "jpg",  "png",
    "bmp",  "gif", "agif", "webp", "wbmp", "ppt",  "pptx", "doc",   "docx", "xls",   "xlsx", "hwp",
    "gul",  "pdf", "txt",  "html", "htm",  "vcf",  "vcs",  "vts"};

TEST_F(FileType, IsTheFirstEntryThatBeginsWithTheExtension) {
  for (int number = 0; number < 80; ++number) {
    int first = 0;
    while (strncmp(kTable[first], kTable[number], strlen(kTable[number])) != 0) ++first;
    EXPECT_EQ(ofExtension(kTable[number]), first) << kTable[number];
  }
}

TEST_F(FileType, CountsTheLastDotOnlyAndIgnoresCase) {
  EXPECT_EQ(ofName("photo.JPG"), 58);
  EXPECT_EQ(ofName("film.Mp4"), 2);
  EXPECT_EQ(ofName("clip.tar.mp4"), 2);
  EXPECT_EQ(ofName("/opt/usr.d/media/song.ogg"), 39);
}

TEST_F(FileType, TakesAPrefixOfAnEarlierEntryForThatEntry) {
  EXPECT_EQ(ofName("page.htm"), 75);
  EXPECT_EQ(ofName("video.m2t"), 21);
  EXPECT_EQ(ofName("x.fl"), 18);
  EXPECT_EQ(ofName("x.mp"), 0);
  EXPECT_EQ(ofName("x.jp"), 57);
  EXPECT_EQ(ofName("x.m3u"), 51);
}

TEST_F(FileType, IsUnknownForWhatIsLongerThanEveryEntryItBeginsWith) {
  EXPECT_EQ(ofName("x.mpeg4"), 80);
  EXPECT_EQ(ofName("x.pdfx"), 80);
}

TEST_F(FileType, IsUnknownWithoutAnExtension) {
  EXPECT_EQ(ofName("README"), 80);
  EXPECT_EQ(ofName("name."), 80);
  EXPECT_EQ(ofName(""), 80);
  EXPECT_EQ(ofExtension(""), 80);
  EXPECT_TRUE(errors().empty());
}

TEST_F(FileType, NeverMatchesTheEndOfTheTable) {
  EXPECT_EQ(ofExtension("invalid"), 80);
  EXPECT_EQ(ofExtension("inv"), 80);
}

TEST_F(FileType, TakesABareExtensionAsAWhole) {
  EXPECT_EQ(ofExtension("pdf"), 73);
  EXPECT_EQ(ofExtension("tar.pdf"), 80);
}

TEST_F(FileType, OfNothingIsThatOfTheFirstEntryAndLogged) {
  EXPECT_EQ(ofName(nullptr), 0);
  EXPECT_EQ(ofExtension(nullptr), 0);
  EXPECT_EQ(errors(), Errors({"fileinfo is NULL", "fileinfo is NULL"}));
}

TEST_F(FileType, GivesTheTablesSpellingToACallerThatHoldsAText) {
  char old[] = "old";
  char* matched = old;
  EXPECT_EQ(ZQViewerCommon::getInstance().getFileTypeNum("a.HTM", &matched, 0), 75);
  EXPECT_EQ(taken(matched), "html");
}

TEST_F(FileType, GivesNothingToACallerThatHoldsNone) {
  char* matched = nullptr;
  EXPECT_EQ(ZQViewerCommon::getInstance().getFileTypeNum("a.pdf", &matched, 0), 73);
  EXPECT_EQ(matched, nullptr);
}

TEST_F(FileType, LeavesTheCallersTextWhenNothingMatches) {
  char old[] = "old";
  char* matched = old;
  EXPECT_EQ(ZQViewerCommon::getInstance().getFileTypeNum("a.exe", &matched, 0), 80);
  EXPECT_EQ(matched, old);
}

TEST_F(FileType, CutsAVeryLongExtension) {
  const std::string name = "x." + std::string(100000, 'm');
  EXPECT_EQ(ofName(name.c_str()), 80);
}

}  // namespace
