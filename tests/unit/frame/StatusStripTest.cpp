// What a window shows around its pages: the strip along its top, messages, and nothing else.

#include <base/Bus.h>
#include <notification_status.h>

#include "FramePages.h"

namespace {

/// As a person turns it: the sensor would turn back a window that turned by itself.
void turnPhone(int degrees) {
  const common::OwnedBus bus = base::systemBus();
  ASSERT_TRUE(bus);
  g_dbus_connection_call(bus.get(), "phone.World", "/phone/World", "phone.World1", "SetRotation",
                         g_variant_new("(i)", degrees), nullptr, G_DBUS_CALL_FLAGS_NONE, -1,
                         nullptr, nullptr, nullptr);
}

class Window : public FrameTest {
 protected:
  Window() { pushed("page"); }

  /// The layout with the strip, which holds the pages.
  Evas_Object* frame() const { return elm_object_parent_widget_get(naviframe->getEvasObj()); }
  std::string text(const char* part) const {
    const char* text = elm_object_part_text_get(frame(), part);
    return text ? text : "";
  }
  std::string stateOf(const char* part) const {
    return edje_object_part_state_get(elm_layout_edje_get(frame()), part, nullptr);
  }
  /// The layout that lies over everything else.
  Evas_Object* banner() const {
    return evas_object_top_get(evas_object_evas_get(window->getEvasObj()));
  }
};

}  // namespace

TEST_F(Window, ShowsTheLatestMessageAsItStands) {
  notification_status_message_post("An older one");
  notification_status_message_post("50 % of <b>\"a\" & b</b>");
  const std::string shown = "50 % of &lt;b&gt;&quot;a&quot; &amp; b&lt;/b&gt;";
  ASSERT_TRUE(waitUntil([&] { return text("message") == shown; })) << text("message");
  EXPECT_EQ(elm_object_text_get(banner()), shown);
  EXPECT_TRUE(evas_object_visible_get(banner()));
  EXPECT_TRUE(evas_object_pass_events_get(banner()));
}

TEST_F(Window, ShowsTheChargeOfTheBattery) {
  EXPECT_TRUE(waitUntil([&] { return text("battery") == "84%"; })) << text("battery");
  EXPECT_TRUE(waitUntil([&] { return stateOf("charge") == "level4"; })) << stateOf("charge");
}

TEST_F(Window, IsFilledHoweverItIsTurned) {
  for (const int degrees : {90, 180, 270, 0}) {
    turnPhone(degrees);
    const bool lies = degrees % 180 != 0;
    EXPECT_TRUE(waitUntil([&] {
      int x = 0, y = 0, width = 0, height = 0;
      evas_object_geometry_get(frame(), &x, &y, &width, &height);
      return x == 0 && y == 0 && width == (lies ? 1280 : 720) && height == (lies ? 720 : 1280);
    })) << degrees;
  }
}
