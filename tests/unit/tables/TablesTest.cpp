#include <efl_assist.h>
#include <gtest/gtest.h>
#include <uxt_theme.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include "ThemeTables.h"

namespace {

constexpr const char* kColors = TABLES_DIR "/com.orlant.zelqo_ChangeableColorTable.xml";
constexpr const char* kFonts = TABLES_DIR "/com.orlant.zelqo_FontInfoTable.xml";
constexpr const char* kCodes[] = {"T024", "T034L2", "AO015", "W025", "W026", "B044", "A03O003L1"};

class WrittenTable {
 public:
  explicit WrittenTable(const std::string& text) {
    char path[] = "/tmp/table-XXXXXX";
    close(mkstemp(path));
    _path = path;
    std::ofstream(_path) << text;
  }
  ~WrittenTable() { std::filesystem::remove(_path); }
  const char* path() const { return _path.c_str(); }

 private:
  std::string _path;
};

void expectColor(const ThemeColor& color, int r, int g, int b, int a) {
  EXPECT_EQ(color.r, r);
  EXPECT_EQ(color.g, g);
  EXPECT_EQ(color.b, b);
  EXPECT_EQ(color.a, a);
}

}  // namespace

TEST(ColorTable, HasEveryCodeOfTheViewerInLightAndDark) {
  const auto table = ColorTable::read(kColors);
  ASSERT_TRUE(table);
  for (const char* code : kCodes) {
    EXPECT_TRUE(table->find(code, ThemeStyle::Light)) << code;
    EXPECT_TRUE(table->find(code, ThemeStyle::Dark)) << code;
  }
  EXPECT_FALSE(table->find("T999", ThemeStyle::Light));
}

TEST(ColorTable, TurnsHueSaturationAndValueIntoRedGreenAndBlue) {
  expectColor(colorFromHsv(0, 100, 100, 100), 255, 0, 0, 255);
  expectColor(colorFromHsv(120, 100, 50, 60), 0, 128, 0, 153);
  expectColor(colorFromHsv(240, 100, 100, 0), 0, 0, 255, 0);
  expectColor(colorFromHsv(300, 0, 40, 100), 102, 102, 102, 255);
}

TEST(ColorTable, BringsNumbersOutOfRangeToTheEdge) {
  expectColor(colorFromHsv(-10, 900, 100, 900), 255, 0, 0, 255);
}

TEST(ColorTable, SkipsEntriesThatAreNotNumbers) {
  const WrittenTable file(
      "<ChangeableColorTables><ChangeableColorTable num='1'><Theme style='Light'>"
      "<ChangeableColorInfo id='bad' hue='red' saturation='1' value='1' alpha='1'/>"
      "<ChangeableColorInfo id='nan' hue='nan' saturation='1' value='1' alpha='1'/>"
      "<ChangeableColorInfo id='good' hue='0' saturation='0' value='100' alpha='100'/>"
      "</Theme></ChangeableColorTable></ChangeableColorTables>");
  const auto table = ColorTable::read(file.path());
  ASSERT_TRUE(table);
  EXPECT_FALSE(table->find("bad", ThemeStyle::Light));
  EXPECT_FALSE(table->find("nan", ThemeStyle::Light));
  EXPECT_TRUE(table->find("good", ThemeStyle::Light));
}

TEST(ColorTable, IsNoTableWhenTheFileIsMissingBrokenOrOfAnotherKind) {
  EXPECT_FALSE(ColorTable::read("/nowhere/table.xml"));
  EXPECT_FALSE(ColorTable::read(nullptr));
  EXPECT_FALSE(ColorTable::read("/tmp"));
  EXPECT_FALSE(ColorTable::read(kFonts));
  const WrittenTable broken("<ChangeableColorTables><Theme");
  EXPECT_FALSE(ColorTable::read(broken.path()));
}

TEST(ColorTable, ReadsNoOtherFilesThroughEntities) {
  const WrittenTable file(
      "<!DOCTYPE t [<!ENTITY e SYSTEM 'file:///etc/hostname'>]>"
      "<ChangeableColorTables><ChangeableColorTable>&e;</ChangeableColorTable>"
      "</ChangeableColorTables>");
  const auto table = ColorTable::read(file.path());
  EXPECT_TRUE(!table || !table->find("", ThemeStyle::Light));
}

TEST(FontTable, HasTheTextClassesOfTheViewer) {
  const auto table = FontTable::read(kFonts);
  ASSERT_TRUE(table);
  ASSERT_TRUE(table->find("T024"));
  EXPECT_EQ(table->find("T024")->size, 28);
  ASSERT_TRUE(table->find("T034L2"));
  EXPECT_EQ(table->find("T034L2")->size, 24);
}

TEST(ThemeColor, IsGivenByTheTableInForce) {
  int r = -1;
  int a = -1;
  EXPECT_FALSE(ea_theme_color_get("AO015", &r, 0, 0, &a, 0, 0, 0, 0, 0, 0, 0, 0));
  EXPECT_EQ(r, -1);
  uxt_theme_color_table_h table = uxt_theme_add_color_table(kColors);
  ASSERT_EQ(uxt_theme_set_color_table(table), 0);
  EXPECT_TRUE(ea_theme_color_get("AO015", &r, 0, 0, &a, 0, 0, 0, 0, 0, 0, 0, 0));
  EXPECT_EQ(r, 255);
  EXPECT_EQ(a, 255);
  uxt_theme_delete_color_table(table);
  EXPECT_FALSE(ea_theme_color_get("AO015", &r, 0, 0, &a, 0, 0, 0, 0, 0, 0, 0, 0));
}

TEST(ThemeFont, IsANewTextAndASizeInPixels) {
  uxt_theme_font_table_h table = uxt_theme_add_font_table(kFonts);
  ASSERT_EQ(uxt_theme_set_font_table(table), 0);
  char* font = nullptr;
  int size = 0;
  EXPECT_TRUE(ea_theme_font_get("T024", &font, &size));
  EXPECT_STREQ(font, "Sans");
  EXPECT_EQ(size, 28);
  free(font);
  EXPECT_FALSE(ea_theme_font_get("unknown", &font, &size));
  EXPECT_FALSE(ea_theme_font_get(nullptr, &font, &size));
  uxt_theme_delete_font_table(table);
}

TEST(ThemeTables, AllowNullHandles) {
  EXPECT_EQ(uxt_theme_set_color_table(nullptr), -22);
  EXPECT_EQ(uxt_theme_set_font_table(nullptr), -22);
  uxt_theme_delete_color_table(nullptr);
  uxt_theme_delete_font_table(nullptr);
}
