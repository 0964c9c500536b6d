#include "ViewerTest.h"
#include "ZQVCommon.h"
#include "ZQVMarkup.h"

namespace {

class Markup : public ViewerTest {
 protected:
  static std::string of(const char* text, const char* textClass, const char* align) {
    return taken(ZQViewerCommon::getInstance().makeThemeMarkup(text, textClass, align));
  }
};

TEST_F(Markup, CarriesFontSizeColourAndAlignmentOfTheClass) {
  EXPECT_EQ(of("hello", "T024", "left"),
            "<font=Sans text_class=T024><font_size=24><color=#123456><align=left>hello</align>"
            "</color></font_size></font>");
}

TEST_F(Markup, KeepsTheLeadingZerosOfAColour) {
  EXPECT_NE(of("x", "T034L2", "center").find("<color=#003456>"), std::string::npos);
}

TEST_F(Markup, IsCutAt1024Characters) {
  EXPECT_EQ(of(std::string(5000, 'x').c_str(), "T024", "left").size(), 1024u);
}

TEST_F(Markup, OfAnUnknownClassIsStillMarkup) {
  EXPECT_NE(of("x", "unknown", "left").find("<align=left>x</align>"), std::string::npos);
}

TEST_F(Markup, BeginsWhereTheReaderDoes) {
  const std::string markup = of("a <align=left>", "T024", "left");
  EXPECT_EQ(zqvFromReadingSide(markup.c_str(), false), markup);
  const std::string mirrored = zqvFromReadingSide(markup.c_str(), true);
  EXPECT_NE(mirrored.find("<align=right>a <align=left></align>"), std::string::npos) << mirrored;
  EXPECT_EQ(zqvFromReadingSide("plain", true), "plain");
}

TEST_F(Markup, ShowsAStrangersNameAsItIs) {
  EXPECT_EQ(zqvEscapeWithin("<b>R&D</b>", 500), "&lt;b&gt;R&amp;D&lt;/b&gt;");
}

TEST_F(Markup, KeepsAStrangersNameOnOneLine) {
  EXPECT_EQ(zqvEscapeWithin("a\nb\tc\x7f\u2028d\u2029", 500), "a b c  d ");
}

TEST_F(Markup, CutsAStrangersNameBetweenCharactersAndEntities) {
  EXPECT_EQ(zqvEscapeWithin("a&b", 5), "a");
  EXPECT_EQ(zqvEscapeWithin("a&b", 6), "a&amp;");
  EXPECT_EQ(zqvEscapeWithin("가나다", 7), "가나");
  EXPECT_EQ(zqvEscapeWithin("abc", 0), "");
}

TEST_F(Markup, SurvivesANameThatIsNoText) {
  EXPECT_EQ(zqvEscapeWithin(nullptr, 10), "");
  EXPECT_EQ(zqvEscapeWithin("a\xff\xfe", 100), "a\uFFFD\uFFFD");
}

TEST_F(Markup, FitsANameIntoItsMessage) {
  // Without a catalogue the message is its own id, which takes no name.
  EXPECT_EQ(zqvFormatName("IDS_NO_SUCH_MESSAGE", "name", 100), "IDS_NO_SUCH_MESSAGE");
}

}  // namespace
