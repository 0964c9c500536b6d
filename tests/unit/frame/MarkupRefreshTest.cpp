#include "MarkupRefresh.h"

#include <Edje.h>
#include <Elementary.h>

#include "FramePages.h"

using app_assist::refreshedMarkup;
using app_assist::TextClassValues;

namespace {

std::string refreshed(const std::string& markup) {
  return refreshedMarkup(markup, [](const std::string& code, TextClassValues* values) {
    *values = {40, 0x00ff07};
    return code == "T024";
  });
}

}  // namespace

TEST(MarkupRefresh, GivesATextTheSizeAndColourOfNow) {
  EXPECT_EQ(refreshed("<font=Sans text_class=T024><font_size=28><color=#15212a><align=left>two "
                      "files</align></color></font_size></font>"),
            "<font=Sans text_class=T024><font_size=40><color=#00ff07><align=left>two "
            "files</align></color></font_size></font>");
}

TEST(MarkupRefresh, ChangesEveryTextOfALabel) {
  EXPECT_EQ(refreshed("<font=A text_class=T024><font_size=1><color=#000000>a<br>"
                      "<font=A text_class=T024><font_size=2><color=#000000>b"),
            "<font=A text_class=T024><font_size=40><color=#00ff07>a<br>"
            "<font=A text_class=T024><font_size=40><color=#00ff07>b");
}

TEST(MarkupRefresh, LeavesWhatItDoesNotKnow) {
  for (const char* markup : {"", "plain", "<font=A text_class=T999><font_size=1><color=#000000>a",
                             "<font=A text_class=T024><color=#000000>a", "<font=A text_class=T024",
                             "<font_size=28><color=#C0C0C0>fixed</color></font_size>"}) {
    EXPECT_EQ(refreshed(markup), markup);
  }
}

class ShownTexts : public FrameTest {
 protected:
  ~ShownTexts() override { edje_text_class_set("label", nullptr, -100); }

  /// What a button asks for.
  static int roomOf(Evas_Object* button) {
    int width = 0;
    evas_object_size_hint_min_get(button, &width, nullptr);
    return width;
  }
  /// A button with a text that is wider than a button needs to be.
  Evas_Object* button(const char* style) {
    Evas_Object* button = elm_button_add(pushed("page")->getEvasObj());
    elm_object_style_set(button, style);
    const int empty = roomOf(button);
    elm_object_text_set(button, "Herunterladen");
    evas_object_show(button);
    EXPECT_TRUE(waitUntil([&] { return roomOf(button) > empty; }));
    return button;
  }
  void doubleTheTexts() {
    edje_text_class_set("label", nullptr, -200);
    app_assist::refreshTexts(window->getEvasObj());
  }
};

TEST_F(ShownTexts, FollowAChangeOfTheirClass) {
  FakePage* page = pushed("page");
  Evas_Object* label = elm_label_add(page->getEvasObj());
  elm_object_text_set(label, "<font=Sans text_class=T077><font_size=28><color=#15212a>text");
  evas_object_show(label);
  edje_text_class_set("T077", "Sans", 33);
  edje_color_class_set("T077", 1, 2, 3, 255, 0, 0, 0, 0, 0, 0, 0, 0);
  app_assist::refreshTexts(window->getEvasObj());
  EXPECT_STREQ(elm_object_text_get(label),
               "<font=Sans text_class=T077><font_size=33><color=#010203>text");
}

TEST_F(ShownTexts, OfAGridAreAskedForAgain) {
  static int asked;
  asked = 0;
  FakePage* page = pushed("page");
  Evas_Object* grid = elm_gengrid_add(page->getEvasObj());
  Elm_Gengrid_Item_Class* cell = elm_gengrid_item_class_new();
  cell->item_style = "default";
  cell->func.content_get = [](void*, Evas_Object*, const char*) -> Evas_Object* {
    asked++;
    return nullptr;
  };
  elm_gengrid_item_size_set(grid, 180, 180);
  elm_gengrid_item_append(grid, cell, nullptr, nullptr, nullptr);
  evas_object_resize(grid, 720, 720);
  evas_object_show(grid);
  ASSERT_TRUE(waitUntil([] { return asked > 0; }));
  passLoop();
  asked = 0;
  app_assist::refreshTexts(window->getEvasObj());
  EXPECT_TRUE(waitUntil([] { return asked > 0; }));
  elm_gengrid_item_class_free(cell);
}

TEST_F(ShownTexts, OfAButtonGetMoreRoom) {
  Evas_Object* download = button("default");
  const int before = roomOf(download);
  doubleTheTexts();
  EXPECT_TRUE(waitUntil([&] { return roomOf(download) > before * 3 / 2; }));
}

TEST_F(ShownTexts, OfAButtonBesideTheTitleStayAsLargeAsTheTitle) {
  Evas_Object* cancel = button("naviframe/title_left");
  const int before = roomOf(cancel);
  doubleTheTexts();
  passLoop();
  EXPECT_EQ(roomOf(cancel), before);
}
