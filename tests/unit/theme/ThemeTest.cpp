/// What the theme draws, on windows nobody sees.
#include <Ecore_Evas.h>
#include <Elementary.h>
#include <gtest/gtest.h>
#include <vconf.h>

#include <algorithm>
#include <cstdlib>
#include <set>
#include <string>
#include <vector>

#include "DeviceTheme.h"

using app_assist::DeviceTheme;

namespace {

constexpr int kWidth = 720;
constexpr int kHeight = 400;

constexpr unsigned kLightAccent = 0xff0a6a8a;
constexpr unsigned kLightAccentPressed = 0xff07506a;
constexpr unsigned kLightFillOff = 0xffd9e2e7;
constexpr unsigned kDarkAccent = 0xff63c7e6;
constexpr unsigned kDarkSurface = 0xff182227;

/// Tinting a picture rounds.
bool alike(unsigned one, unsigned other) {
  for (int shift : {0, 8, 16, 24}) {
    const int a = static_cast<int>(one >> shift & 0xff);
    const int b = static_cast<int>(other >> shift & 0xff);
    if (std::abs(a - b) > 2) return false;
  }
  return true;
}

void choose(const char* palette) {
  vconf_set_str("db/setting/theme", palette);
  DeviceTheme::applyPalette();
}

void chooseTextSize(int percent) {
  vconf_set_int("db/setting/accessibility/font_size", percent);
  DeviceTheme::applyTextSize();
}

/// One widget on a white window.
class DrawnTheme : public testing::Test {
 protected:
  DrawnTheme() {
    choose("light");
    chooseTextSize(100);
    _window = elm_win_add(nullptr, "theme-test", ELM_WIN_BASIC);
    evas_object_resize(_window, kWidth, kHeight);
    Evas_Object* ground = evas_object_rectangle_add(evas_object_evas_get(_window));
    evas_object_resize(ground, kWidth, kHeight);
    evas_object_show(ground);
    evas_object_show(_window);
  }
  ~DrawnTheme() override {
    evas_object_del(_window);
    choose("light");
    chooseTextSize(100);
  }

  Evas_Object* window() const { return _window; }

  Evas_Object* shown(Evas_Object* widget, int height = kHeight) {
    evas_object_resize(widget, kWidth, height);
    evas_object_show(widget);
    return widget;
  }
  Evas_Object* button(const char* style, const char* text) {
    Evas_Object* button = elm_button_add(_window);
    EXPECT_TRUE(elm_object_style_set(button, style)) << style;
    elm_object_text_set(button, text);
    return button;
  }

  std::vector<unsigned> pixels() {
    Evas* canvas = evas_object_evas_get(_window);
    Ecore_Evas* drawn = ecore_evas_ecore_evas_get(canvas);
    evas_smart_objects_calculate(canvas);
    ecore_evas_manual_render(drawn);
    const auto* first = static_cast<const unsigned*>(ecore_evas_buffer_pixels_get(drawn));
    int width = 0, height = 0;
    ecore_evas_geometry_get(drawn, nullptr, nullptr, &width, &height);
    EXPECT_EQ(width, kWidth);
    return first ? std::vector<unsigned>(first, first + width * height)
                 : std::vector<unsigned>(kWidth * kHeight);
  }
  unsigned pixel(int x, int y) { return pixels()[static_cast<size_t>(y) * kWidth + x]; }
  bool draws(unsigned colour) {
    const auto all = pixels();
    return std::any_of(all.begin(), all.end(), [=](unsigned one) { return alike(one, colour); });
  }

  void press(int x, int y) {
    Evas* canvas = evas_object_evas_get(_window);
    evas_event_feed_mouse_move(canvas, x, y, 0, nullptr);
    evas_event_feed_mouse_down(canvas, 1, EVAS_BUTTON_NONE, 1, nullptr);
    ecore_main_loop_iterate();
  }
  void release() {
    evas_event_feed_mouse_up(evas_object_evas_get(_window), 1, EVAS_BUTTON_NONE, 2, nullptr);
    ecore_main_loop_iterate();
  }

 private:
  Evas_Object* _window;
};

using ThemeButton = DrawnTheme;
using ThemeText = DrawnTheme;
using ThemeCheck = DrawnTheme;
using ThemeStrip = DrawnTheme;
using ThemeStyles = DrawnTheme;

void count(void* counter, Evas_Object*, void*) {
  ++*static_cast<int*>(counter);
}

}  // namespace

TEST_F(ThemeStyles, AreThereForEveryWidgetOfTheApplications) {
  for (const char* style : {"default", "bottom", "popup/default", "naviframe/end_btn/default",
                            "naviframe/title_left", "naviframe/title_right"}) {
    EXPECT_TRUE(elm_object_style_set(elm_button_add(window()), style)) << "button " << style;
  }
  for (const char* style : {"default", "list", "popup", "toggle"})
    EXPECT_TRUE(elm_object_style_set(elm_check_add(window()), style)) << "check " << style;
  for (const char* style : {"default", "process_medium"})
    EXPECT_TRUE(elm_object_style_set(elm_progressbar_add(window()), style)) << "bar " << style;
  for (const char* style : {"default", "popup/default"})
    EXPECT_TRUE(elm_object_style_set(elm_label_add(window()), style)) << "label " << style;
  for (const char* style : {"default", "no_effect"})
    EXPECT_TRUE(elm_object_style_set(elm_gengrid_add(window()), style)) << "grid " << style;
  for (const char* group : {"list/C/type.1", "list/B/type.2"})
    EXPECT_TRUE(elm_layout_theme_set(elm_layout_add(window()), "layout", group, "default"))
        << group;
  EXPECT_TRUE(elm_layout_theme_set(elm_layout_add(window()), "layout", "phone", "window"));
}

TEST_F(ThemeStyles, DrawTwoLinesInPlainAndInCompressedLists) {
  for (const char* group :
       {"elm/genlist/item/2line/default", "elm/genlist/item_compress/2line/default"}) {
    Evas_Object* row = edje_object_add(evas_object_evas_get(window()));
    ASSERT_TRUE(edje_object_file_set(row, DEVICE_THEME, group)) << group;
    for (const char* part : {"elm.text.main.left", "elm.text.sub.left", "elm.icon.1", "elm.icon.2"})
      EXPECT_TRUE(edje_object_part_exists(row, part)) << group << " " << part;
    evas_object_del(row);
  }
}

TEST_F(ThemeButton, IsFilledWithTheAccent) {
  shown(button("bottom", "Download"), 104);
  EXPECT_PRED2(alike, pixel(60, 52), kLightAccent);
}

TEST_F(ThemeButton, ShowsThatItIsPressedAtOnce) {
  shown(button("bottom", "Download"), 104);
  pixels();
  press(60, 52);
  EXPECT_PRED2(alike, pixel(60, 52), kLightAccentPressed);
  release();
}

TEST_F(ThemeButton, ClicksUnlessItIsDisabled) {
  int clicks = 0;
  Evas_Object* widget = shown(button("bottom", "Download"), 104);
  evas_object_smart_callback_add(widget, "clicked", count, &clicks);
  pixels();
  press(60, 52);
  release();
  EXPECT_EQ(clicks, 1);

  elm_object_disabled_set(widget, EINA_TRUE);
  ecore_main_loop_iterate();
  EXPECT_PRED2(alike, pixel(60, 52), kLightFillOff);
  press(60, 52);
  EXPECT_PRED2(alike, pixel(60, 52), kLightFillOff);
  release();
  EXPECT_EQ(clicks, 1);
}

TEST_F(ThemeButton, HasRoundEnds) {
  shown(button("bottom", "Download"), 104);
  EXPECT_FALSE(alike(pixel(3, 3), kLightAccent));
  EXPECT_FALSE(alike(pixel(kWidth - 4, 100), kLightAccent));
  EXPECT_PRED2(alike, pixel(3, 52), kLightAccent);
}

TEST_F(ThemeButton, DrawsALongLabelSmallerThanItself) {
  Evas_Object* widget = shown(button("bottom", "Herunterladen und mit allen Kontakten teilen"));
  evas_object_resize(widget, 300, 104);
  pixels();
  const Evas_Object* text = edje_object_part_object_get(elm_layout_edje_get(widget), "elm.text");
  int room = 0, width = 0;
  evas_object_geometry_get(text, nullptr, nullptr, &room, nullptr);
  evas_object_textblock_size_formatted_get(text, &width, nullptr);
  EXPECT_LE(room, 300 - 2 * 32);
  EXPECT_LE(width, room);
  EXPECT_GT(width, room / 2);
}

TEST_F(ThemeButton, IsHighEnoughForAFinger) {
  for (const char* style : {"default", "bottom", "popup/default", "naviframe/end_btn/default",
                            "naviframe/title_left", "naviframe/title_right"}) {
    int width = 0, height = 0;
    edje_object_size_min_calc(elm_layout_edje_get(button(style, "OK")), &width, &height);
    EXPECT_GE(width, 88) << style;
    EXPECT_GE(height, 88) << style;
  }
}

TEST_F(ThemeText, FollowsThePaletteWhileItIsShown) {
  Evas_Object* label = elm_label_add(window());
  elm_object_text_set(label, "\u2588\u2588\u2588\u2588");
  shown(label);
  EXPECT_TRUE(draws(0xff15212a));
  choose("dark");
  EXPECT_TRUE(draws(0xffe9f0f3));
  EXPECT_FALSE(draws(0xff15212a));
}

TEST_F(ThemeText, KeepsTheColoursThatItBrings) {
  Evas_Object* label = elm_label_add(window());
  elm_object_text_set(label, "<color=#C0C0C0>\u2588\u2588\u2588\u2588</color>");
  shown(label);
  choose("dark");
  EXPECT_TRUE(draws(0xffc0c0c0));
}

TEST_F(ThemeText, GrowsWithTheAccessibilitySetting) {
  Evas_Object* label = elm_label_add(window());
  elm_object_text_set(label, "Size");
  shown(label);
  pixels();
  int before = 0, after = 0;
  evas_object_size_hint_min_get(label, nullptr, &before);
  chooseTextSize(200);
  elm_object_text_set(label, "Size.");
  pixels();
  evas_object_size_hint_min_get(label, nullptr, &after);
  EXPECT_GT(after, before * 3 / 2);
}

TEST_F(ThemeButton, ChangesWithThePaletteWhileItIsShown) {
  shown(button("bottom", "Download"), 104);
  EXPECT_PRED2(alike, pixel(60, 52), kLightAccent);
  choose("dark");
  EXPECT_PRED2(alike, pixel(60, 52), kDarkAccent);
}

TEST_F(ThemeCheck, FillsItsDiscWhenItIsOn) {
  Evas_Object* check = elm_check_add(window());
  elm_object_style_set(check, "list");
  shown(check, 60);
  EXPECT_FALSE(draws(kLightAccent));
  elm_check_state_set(check, EINA_TRUE);
  EXPECT_TRUE(draws(kLightAccent));
  elm_check_state_set(check, EINA_FALSE);
  EXPECT_FALSE(draws(kLightAccent));
}

TEST_F(ThemeCheck, TintsThePictureThatItMarks) {
  Evas_Object* check = elm_check_add(window());
  shown(check);
  EXPECT_EQ(pixel(kWidth / 2, kHeight / 2), 0xffffffffu);
  elm_check_state_set(check, EINA_TRUE);
  const unsigned tinted = pixel(kWidth / 2, kHeight / 2);
  EXPECT_NEAR((tinted >> 16) & 0xff, 255 - (255 - 0x0a) / 4, 4);
}

TEST_F(ThemeStrip, ShowsOneKindOfNetwork) {
  Evas_Object* strip = elm_layout_add(window());
  ASSERT_TRUE(elm_layout_theme_set(strip, "layout", "phone", "window"));
  Evas_Object* edje = elm_layout_edje_get(strip);
  for (const char* kind : {"wifi", "cellular", "none", "wired"}) {
    elm_object_signal_emit(strip, (std::string("network,") + kind).c_str(), "elm");
    edje_object_message_signal_process(edje);
    std::set<std::string> visible;
    for (const char* sign : {"wifi", "cellular", "offline", "wired"}) {
      if (std::string(edje_object_part_state_get(edje, sign, nullptr)) == "visible")
        visible.insert(sign);
    }
    EXPECT_EQ(visible, std::set<std::string>{std::string(kind) == "none" ? "offline" : kind});
  }
}

TEST_F(ThemeStrip, StandsOnTheSurfaceOfThePalette) {
  Evas_Object* strip = elm_layout_add(window());
  elm_layout_theme_set(strip, "layout", "phone", "window");
  shown(strip);
  EXPECT_EQ(pixel(kWidth / 2, 4), 0xffffffffu);
  choose("dark");
  EXPECT_PRED2(alike, pixel(kWidth / 2, 4), kDarkSurface);
}
