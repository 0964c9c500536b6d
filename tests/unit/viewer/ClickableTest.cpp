#include "PageTest.h"
#include "ZQVCommon.h"
#include "ZQVPictureButton.h"

namespace {

struct Colour {
  int r, g, b, a;
  bool operator==(const Colour& other) const {
    return r == other.r && g == other.g && b == other.b && a == other.a;
  }
};

class Clickable : public PageTest {
 protected:
  void SetUp() override {
    PageTest::SetUp();
    object = evas_object_rectangle_add(evas_object_evas_get(window));
    evas_object_color_set(object, 100, 80, 61, 255);
  }
  void TearDown() override {
    evas_object_del(object);
    PageTest::TearDown();
  }
  Colour colour() const {
    Colour now{};
    evas_object_color_get(object, &now.r, &now.g, &now.b, &now.a);
    return now;
  }
  void makeClickable() {
    ZQViewerCommon::getInstance().setClickable(object, this, nullptr, nullptr, nullptr);
  }
  void press(int x, int y) { press(&ZQViewerCommon::clickableSelectCb, nullptr, x, y); }
  void move(int x, int y, int buttons = 1) {
    move(&ZQViewerCommon::clickableMouseMove_cb, nullptr, x, y, buttons);
  }
  void release() { ZQViewerCommon::clickableReleaseCb(nullptr, nullptr, object, nullptr); }
  void press(Evas_Object_Event_Cb callback, void* data, int x, int y) {
    Evas_Event_Mouse_Down event = {};
    event.canvas.x = x;
    event.canvas.y = y;
    callback(data, nullptr, object, &event);
  }
  void move(Evas_Object_Event_Cb callback, void* data, int x, int y, int buttons = 1) {
    Evas_Event_Mouse_Move event = {};
    event.buttons = buttons;
    event.cur.canvas.x = x;
    event.cur.canvas.y = y;
    callback(data, nullptr, object, &event);
  }
  bool isMoving() const { return ZQViewerCommon::getInstance().isMoving(object); }

  Evas_Object* object = nullptr;
};

TEST_F(Clickable, IsDarkWhileItIsPressed) {
  makeClickable();
  press(10, 10);
  EXPECT_EQ(colour(), (Colour{50, 40, 30, 255}));
  release();
  EXPECT_EQ(colour(), (Colour{100, 80, 60, 255}));
}

TEST_F(Clickable, TakesAMoveOf30PixelsForATap) {
  makeClickable();
  press(100, 100);
  move(130, 70);
  EXPECT_FALSE(isMoving());
  EXPECT_EQ(colour(), (Colour{50, 40, 30, 255}));
  release();
  EXPECT_FALSE(isMoving());
}

TEST_F(Clickable, TakesAMoveOf31PixelsOnAnyAxisForADrag) {
  for (const auto& [x, y] : {std::pair{131, 100}, {69, 100}, {100, 131}, {100, 69}}) {
    makeClickable();
    press(100, 100);
    move(x, y);
    EXPECT_TRUE(isMoving());
    release();
    EXPECT_FALSE(isMoving());
  }
}

TEST_F(Clickable, IsTwiceAsBrightAfterADrag) {
  makeClickable();
  press(0, 0);
  move(31, 0);
  EXPECT_EQ(colour(), (Colour{100, 80, 60, 255}));
  release();
  EXPECT_EQ(colour(), (Colour{200, 160, 120, 255}));
}

TEST_F(Clickable, NeverGetsBrighterThanItsAlpha) {
  makeClickable();
  evas_object_color_set(object, 200, 100, 10, 200);
  release();
  EXPECT_EQ(colour(), (Colour{200, 200, 20, 200}));
}

TEST_F(Clickable, IgnoresAPointerThatOnlyHovers) {
  makeClickable();
  press(0, 0);
  release();
  move(200, 200, 0);
  EXPECT_FALSE(isMoving());
}

TEST_F(Clickable, LogsEventsWithoutInformation) {
  makeClickable();
  ZQViewerCommon::clickableSelectCb(nullptr, nullptr, object, nullptr);
  EXPECT_EQ(colour(), (Colour{50, 40, 30, 255}));
  ZQViewerCommon::clickableMouseMove_cb(nullptr, nullptr, object, nullptr);
  EXPECT_EQ(errors(), Errors({"Invalid argument: event info is NULL",
                              "Invalid argument: event info is NULL"}));
}

TEST_F(Clickable, RunsItsOwnCallbacksWhereGiven) {
  static int calls = 0;
  const Evas_Object_Event_Cb count = [](void*, Evas*, Evas_Object*, void*) { ++calls; };
  ZQViewerCommon::getInstance().setClickable(object, this, count, count, count);
  evas_object_resize(object, 100, 100);
  evas_object_raise(object);
  evas_object_show(object);
  Evas* canvas = evas_object_evas_get(object);
  evas_event_feed_mouse_move(canvas, 10, 10, 0, nullptr);
  calls = 0;
  evas_event_feed_mouse_down(canvas, 1, EVAS_BUTTON_NONE, 0, nullptr);
  evas_event_feed_mouse_move(canvas, 12, 12, 0, nullptr);
  evas_event_feed_mouse_up(canvas, 1, EVAS_BUTTON_NONE, 0, nullptr);
  EXPECT_EQ(calls, 3);
}

TEST_F(Clickable, OfNothingDoesNothing) {
  ZQViewerCommon::getInstance().setClickable(nullptr, nullptr, nullptr, nullptr, nullptr);
  ZQViewerCommon::getInstance().dimObject(nullptr);
}

TEST_F(Clickable, DimsToHalfItsAlpha) {
  evas_object_color_set(object, 255, 255, 255, 255);
  ZQViewerCommon::getInstance().dimObject(object);
  EXPECT_EQ(colour(), (Colour{127, 127, 127, 127}));
}

/// A picture of the full view's pager and the button that it acts for.
class PictureButton : public Clickable {
 protected:
  void SetUp() override {
    Clickable::SetUp();
    grid = elm_gengrid_add(window);
    button = elm_button_add(window);
    elm_object_text_set(button, "Open");
    evas_object_data_set(grid, "bindedObject", button);
    evas_object_data_set(grid, "bindedObjectClickedCbData", this);
    evas_object_smart_callback_add(
        button, "clicked",
        [](void* data, Evas_Object*, void* info) {
          static_cast<PictureButton*>(data)->clicks += info == data;
        },
        this);
    makeClickable();
  }
  void TearDown() override {
    evas_object_del(button);
    evas_object_del(grid);
    Clickable::TearDown();
  }
  void makeVideoIcon() {
    evas_object_del(object);
    object = elm_icon_add(window);
    elm_image_file_set(object, ZQVPictureButton::kVideoIcon, nullptr);
    evas_object_resize(object, 101, 60);
    makeClickable();
  }
  void down(int x, int y) { press(&ZQVPictureButton::_mouseDownCb, grid, x, y); }
  void drag(int x, int y) { move(&ZQVPictureButton::_mouseMoveCb, grid, x, y); }
  void up() {
    Evas_Event_Mouse_Up event = {};
    ZQVPictureButton::_mouseUpCb(grid, nullptr, object, &event);
  }
  std::pair<int, int> size() const {
    int width = 0, height = 0;
    evas_object_geometry_get(object, nullptr, nullptr, &width, &height);
    return {width, height};
  }
  std::string themeColour() const {
    const char* code = static_cast<char*>(evas_object_data_get(object, "test_color"));
    return code ? code : "";
  }

  Evas_Object* grid = nullptr;
  Evas_Object* button = nullptr;
  int clicks = 0;
};

TEST_F(PictureButton, PressesTheOpenButtonWhenTapped) {
  down(10, 10);
  EXPECT_EQ(colour(), (Colour{50, 40, 30, 255}));
  up();
  EXPECT_EQ(clicks, 1);
  EXPECT_EQ(colour(), (Colour{100, 80, 60, 255}));
}

TEST_F(PictureButton, DoesNothingWhileTheButtonDoesNotOpen) {
  elm_object_text_set(button, "Download");
  down(10, 10);
  up();
  EXPECT_EQ(clicks, 0);
  EXPECT_EQ(colour(), (Colour{100, 80, 61, 255}));
}

TEST_F(PictureButton, DoesNothingWithoutAButton) {
  evas_object_data_del(grid, "bindedObjectClickedCbData");
  down(10, 10);
  up();
  evas_object_data_del(grid, "bindedObject");
  down(10, 10);
  up();
  EXPECT_EQ(clicks, 0);
}

TEST_F(PictureButton, IsNotPressedByADrag) {
  down(0, 0);
  move(&ZQViewerCommon::clickableMouseMove_cb, grid, 31, 0);
  up();
  EXPECT_EQ(clicks, 0);
}

TEST_F(PictureButton, ShrinksThePlayMarkWhilePressed) {
  makeVideoIcon();
  down(0, 0);
  EXPECT_EQ(size(), std::pair(70, 42));
  EXPECT_EQ(themeColour(), "B044");
  up();
  EXPECT_EQ(clicks, 1);
  EXPECT_EQ(size(), std::pair(101, 60));
  EXPECT_EQ(themeColour(), "W025");
  EXPECT_EQ(traces(), Errors({"Video icon was mouse down!", "Video icon was mouse up!"}));
}

TEST_F(PictureButton, ShrinksFromTheRememberedSizeEveryTime) {
  makeVideoIcon();
  down(0, 0);
  down(0, 0);
  EXPECT_EQ(size(), std::pair(70, 42));
}

TEST_F(PictureButton, KeepsThePlayMarkSmallInAShortDrag) {
  makeVideoIcon();
  down(0, 0);
  drag(30, 30);
  EXPECT_FALSE(isMoving());
  drag(31, 0);
  EXPECT_TRUE(isMoving());
  drag(100, 100);
  EXPECT_EQ(size(), std::pair(70, 42));
  EXPECT_EQ(themeColour(), "B044");
  up();
  EXPECT_EQ(clicks, 0);
  EXPECT_EQ(size(), std::pair(101, 60));
  EXPECT_FALSE(isMoving());
}

TEST_F(PictureButton, RestoresThePlayMarkInALongDrag) {
  makeVideoIcon();
  down(0, 0);
  drag(0, 101);
  EXPECT_EQ(size(), std::pair(101, 60));
  EXPECT_EQ(themeColour(), "W025");
  // The message of the press stands for the move, too.
  EXPECT_EQ(traces(), Errors({"Video icon was mouse down!", "Video icon was mouse down!"}));
}

TEST_F(PictureButton, LogsCallsWithoutArguments) {
  Evas_Event_Mouse_Down event = {};
  for (const auto callback : {&ZQVPictureButton::_mouseDownCb, &ZQVPictureButton::_mouseMoveCb,
                              &ZQVPictureButton::_mouseUpCb}) {
    callback(nullptr, nullptr, object, &event);
    callback(grid, nullptr, object, nullptr);
    EXPECT_EQ(errors(), Errors({"!data", "Invalid argument: event info is NULL"}));
    FakeLog::get().clear();
  }
}

TEST_F(PictureButton, SurvivesAButtonThatTakesThePictureAway) {
  evas_object_smart_callback_add(
      button, "clicked",
      [](void* data, Evas_Object*, void*) { evas_object_del(static_cast<Evas_Object*>(data)); },
      object);
  down(10, 10);
  up();
  EXPECT_EQ(clicks, 1);
  object = evas_object_rectangle_add(evas_object_evas_get(window));
}

}  // namespace
