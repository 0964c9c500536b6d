#include <Edje.h>

#include "../views/ViewTest.h"
#include "Names.h"
#include "ZQVCellParts.h"
#include "ZQVMarkup.h"
#include "ZQVOwned.h"

namespace {

/// What a reader can see of a name: text, on one line.
std::string visibleIn(const std::string& name) {
  const ZQVOwnedText valid(g_utf8_make_valid(name.c_str(), -1));
  std::string visible;
  for (const char* at = valid.get(); *at; at = g_utf8_next_char(at)) {
    const GUnicodeType type = g_unichar_type(g_utf8_get_char(at));
    const bool breaks = type == G_UNICODE_CONTROL || type == G_UNICODE_LINE_SEPARATOR ||
                        type == G_UNICODE_PARAGRAPH_SEPARATOR;
    visible += breaks ? " " : std::string(at, static_cast<size_t>(g_utf8_next_char(at) - at));
  }
  return visible;
}

/// The text that a label of the cells draws.
std::string drawn(Evas_Object* label) {
  const Evas_Object* block = edje_object_part_object_get(elm_layout_edje_get(label), "elm.text");
  Evas_Textblock_Cursor* start = evas_object_textblock_cursor_new(block);
  Evas_Textblock_Cursor* end = evas_object_textblock_cursor_new(block);
  evas_textblock_cursor_paragraph_first(start);
  evas_textblock_cursor_paragraph_last(end);
  const ZQVPlatformText text(
      evas_textblock_cursor_range_text_get(start, end, EVAS_TEXTBLOCK_TEXT_PLAIN));
  evas_textblock_cursor_free(start);
  evas_textblock_cursor_free(end);
  return text ? text.get() : "";
}

using EscapedName = ViewTest;

}  // namespace

TEST_F(EscapedName, ShowsTheSameVisibleTextForAnyName) {
  Evas_Object* label = zqvCreateLabel(TestApp::get().window(), "");
  EXPECT_TRUE(rc::check([label] {
    const std::string name = *names();
    elm_object_text_set(label, ("<b>" + zqvEscapeWithin(name.c_str(), SIZE_MAX) + "</b>").c_str());
    RC_ASSERT(drawn(label) == visibleIn(name));
  }));
  evas_object_del(label);
}

TEST_F(EscapedName, CutAnywhereIsTheBeginningOfTheWholeText) {
  Evas_Object* label = zqvCreateLabel(TestApp::get().window(), "");
  EXPECT_TRUE(rc::check([label] {
    const std::string name = *names();
    const std::string markup = zqvEscapeWithin(name.c_str(), *rc::gen::inRange<size_t>(0, 64));
    elm_object_text_set(label, ("<b>" + markup + "</b>").c_str());
    const std::string cut = drawn(label);
    RC_ASSERT(visibleIn(name).compare(0, cut.size(), cut) == 0);
  }));
  evas_object_del(label);
}
