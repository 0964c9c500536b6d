#include <Edje.h>
#include <efl_assist.h>
#include <gtest/gtest.h>
#include <uxt_theme.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include "ColourTable.h"
#include "FontTable.h"

using theme::Colour;
using theme::ColourTable;
using theme::FontTable;
using theme::Style;

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

bool has(const ColourTable& table, const char* code, Style style) {
  return table.colours(style).count(code) == 1;
}

/// What the codes are looked up in.
class CurrentCodes : public testing::Test {
 protected:
  CurrentCodes() { edje_init(); }
  ~CurrentCodes() override { edje_shutdown(); }
};

using ThemeColour = CurrentCodes;
using ThemeFont = CurrentCodes;

}  // namespace

TEST(ColourTable, HasEveryCodeOfTheViewerInLightAndDark) {
  const auto table = ColourTable::read(kColors);
  ASSERT_TRUE(table);
  for (const char* code : kCodes) {
    EXPECT_TRUE(has(*table, code, Style::Light)) << code;
    EXPECT_TRUE(has(*table, code, Style::Dark)) << code;
  }
  EXPECT_FALSE(has(*table, "T999", Style::Light));
}

TEST(ColourTable, TurnsHueSaturationAndValueIntoRedGreenAndBlue) {
  EXPECT_EQ(theme::fromHsv(0, 100, 100, 100), (Colour{255, 0, 0, 255}));
  EXPECT_EQ(theme::fromHsv(360, 100, 100, 100), (Colour{255, 0, 0, 255}));
  EXPECT_EQ(theme::fromHsv(120, 100, 50, 60), (Colour{0, 128, 0, 153}));
  EXPECT_EQ(theme::fromHsv(240, 100, 100, 0), (Colour{0, 0, 255, 0}));
  EXPECT_EQ(theme::fromHsv(300, 0, 40, 100), (Colour{102, 102, 102, 255}));
}

TEST(ColourTable, SkipsEntriesWithoutSensibleNumbers) {
  const WrittenTable file(
      "<ChangeableColorTables><ChangeableColorTable num='1'><Theme style='Light'>"
      "<ChangeableColorInfo id='bad' hue='red' saturation='1' value='1' alpha='1'/>"
      "<ChangeableColorInfo id='nan' hue='nan' saturation='1' value='1' alpha='1'/>"
      "<ChangeableColorInfo id='over' hue='361' saturation='1' value='1' alpha='1'/>"
      "<ChangeableColorInfo id='none' hue='3' saturation='1' value='1'/>"
      "<ChangeableColorInfo id='good' hue='0' saturation='0' value='100' alpha='100'/>"
      "</Theme></ChangeableColorTable></ChangeableColorTables>");
  const auto table = ColourTable::read(file.path());
  ASSERT_TRUE(table);
  EXPECT_FALSE(has(*table, "bad", Style::Light));
  EXPECT_FALSE(has(*table, "nan", Style::Light));
  EXPECT_FALSE(has(*table, "over", Style::Light));
  EXPECT_FALSE(has(*table, "none", Style::Light));
  EXPECT_TRUE(has(*table, "good", Style::Light));
}

TEST(ColourTable, IsNoTableWhenTheFileIsMissingBrokenOrOfAnotherKind) {
  EXPECT_FALSE(ColourTable::read("/nowhere/table.xml"));
  EXPECT_FALSE(ColourTable::read(nullptr));
  EXPECT_FALSE(ColourTable::read("/tmp"));
  EXPECT_FALSE(ColourTable::read(kFonts));
  const WrittenTable broken("<ChangeableColorTables><Theme");
  EXPECT_FALSE(ColourTable::read(broken.path()));
}

TEST(ColourTable, ReadsNoOtherFilesThroughEntities) {
  const WrittenTable file(
      "<!DOCTYPE t [<!ENTITY e SYSTEM 'file:///etc/hostname'>]>"
      "<ChangeableColorTables><ChangeableColorTable>&e;</ChangeableColorTable>"
      "</ChangeableColorTables>");
  const auto table = ColourTable::read(file.path());
  EXPECT_TRUE(!table || !has(*table, "", Style::Light));
}

TEST(FontTable, HasTheTextClassesOfTheViewer) {
  const auto table = FontTable::read(kFonts);
  ASSERT_TRUE(table);
  ASSERT_EQ(table->fonts().count("T024"), 1u);
  EXPECT_EQ(table->fonts().at("T024").size, 28);
  ASSERT_EQ(table->fonts().count("T034L2"), 1u);
  EXPECT_EQ(table->fonts().at("T034L2").size, 24);
}

TEST_F(ThemeColour, IsGivenByTheTableInForce) {
  int r = -1;
  int a = -1;
  EXPECT_FALSE(ea_theme_color_get("AO015", &r, 0, 0, &a, 0, 0, 0, 0, 0, 0, 0, 0));
  uxt_theme_color_table_h table = uxt_theme_add_color_table(kColors);
  ASSERT_EQ(uxt_theme_set_color_table(table), 0);
  EXPECT_TRUE(ea_theme_color_get("AO015", &r, 0, 0, &a, 0, 0, 0, 0, 0, 0, 0, 0));
  EXPECT_EQ(r, 255);
  EXPECT_EQ(a, 255);
  uxt_theme_delete_color_table(table);
  EXPECT_FALSE(ea_theme_color_get("AO015", &r, 0, 0, &a, 0, 0, 0, 0, 0, 0, 0, 0));
}

TEST_F(ThemeFont, IsANewTextAndASizeInPixels) {
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
