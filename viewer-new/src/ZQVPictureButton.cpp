#include "ZQVPictureButton.h"

#include <efl_assist.h>
#include <glib.h>

#include "ZQVCommon.h"
#include "ZQVIcons.h"
#include "ZQVLog.h"
#include "ZQVPressPoint.h"
#include "ZQVText.h"
#include "ZQVWeakObject.h"

const char* const ZQVPictureButton::kVideoIcon =
    ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_video_bg.png";

namespace {

constexpr int kLeaveDistance = 100;
constexpr double kPressedSize = 0.7;

bool hasArguments(void* data, void* info) {
  if (!data) {
    ZQV_ERROR("!data");
    return false;
  }
  if (!info) {
    ZQV_ERROR("Invalid argument: event info is NULL");
    return false;
  }
  return true;
}

/// The button that the grid is bound to, if it opens the file now.
Evas_Object* openButtonOf(Evas_Object* grid) {
  auto* button =
      static_cast<Evas_Object*>(evas_object_data_get(grid, ZQVPictureButton::kBoundButton));
  if (!button || !evas_object_data_get(grid, ZQVPictureButton::kBoundData)) return nullptr;
  const bool opens = g_strcmp0(elm_object_text_get(button), zqvText("IDS_RSH_BUTTON_OPEN")) == 0;
  return opens ? button : nullptr;
}

bool isVideoIcon(Evas_Object* obj) {
  if (g_strcmp0(evas_object_type_get(obj), "elm_icon") != 0) return false;
  const char* file = nullptr;
  elm_image_file_get(obj, &file, nullptr);
  return g_strcmp0(file, ZQVPictureButton::kVideoIcon) == 0;
}

int dataOf(Evas_Object* obj, const char* key) {
  return GPOINTER_TO_INT(evas_object_data_get(obj, key));
}

void setSize(Evas_Object* obj, int width, int height) {
  evas_object_size_hint_min_set(obj, width, height);
  evas_object_size_hint_max_set(obj, width, height);
  evas_object_resize(obj, width, height);
}

void rememberSize(Evas_Object* obj) {
  if (dataOf(obj, "width") != 0 || dataOf(obj, "height") != 0) return;
  int width = 0;
  int height = 0;
  evas_object_geometry_get(obj, nullptr, nullptr, &width, &height);
  evas_object_data_set(obj, "width", GINT_TO_POINTER(width));
  evas_object_data_set(obj, "height", GINT_TO_POINTER(height));
}

void restoreSize(Evas_Object* obj) {
  int width = 0;
  int height = 0;
  evas_object_geometry_get(obj, nullptr, nullptr, &width, &height);
  if (width == dataOf(obj, "width") && height == dataOf(obj, "height")) return;
  setSize(obj, dataOf(obj, "width"), dataOf(obj, "height"));
}

void pressVideoIcon(Evas_Object* obj, const Evas_Event_Mouse_Down* event) {
  ZQV_TRACE("Video icon was mouse down!");
  if (ZQVPressPoint* press = ZQVPressPoint::of(obj)) *press = {event->canvas.x, event->canvas.y};
  ZQVPressPoint::setMoving(obj, false);
  rememberSize(obj);
  setSize(obj, static_cast<int>(dataOf(obj, "width") * kPressedSize),
          static_cast<int>(dataOf(obj, "height") * kPressedSize));
  ea_theme_object_color_set(obj, "B044");
}

void moveOnVideoIcon(Evas_Object* obj, const Evas_Event_Mouse_Move* event) {
  ZQV_TRACE("Video icon was mouse down!");
  const ZQVPressPoint* press = ZQVPressPoint::of(obj);
  if (!press || !press->isFurtherThan(ZQVPressPoint::kTapDistance, event->cur.canvas)) return;
  ZQVPressPoint::setMoving(obj, true);
  if (!press->isFurtherThan(kLeaveDistance, event->cur.canvas)) return;
  restoreSize(obj);
  ea_theme_object_color_set(obj, "W025");
}

void releaseVideoIcon(Evas_Object* obj) {
  ZQV_TRACE("Video icon was mouse up!");
  ZQVPressPoint::setMoving(obj, false);
  restoreSize(obj);
  ea_theme_object_color_set(obj, "W025");
}

}  // namespace

void ZQVPictureButton::_mouseDownCb(void* data, Evas* canvas, Evas_Object* obj, void* info) {
  if (!hasArguments(data, info) || !openButtonOf(static_cast<Evas_Object*>(data))) return;
  if (isVideoIcon(obj)) {
    pressVideoIcon(obj, static_cast<Evas_Event_Mouse_Down*>(info));
  } else {
    ZQViewerCommon::clickableSelectCb(data, canvas, obj, info);
  }
}

void ZQVPictureButton::_mouseMoveCb(void* data, Evas* canvas, Evas_Object* obj, void* info) {
  if (!hasArguments(data, info) || !openButtonOf(static_cast<Evas_Object*>(data))) return;
  const auto* event = static_cast<Evas_Event_Mouse_Move*>(info);
  if (!event->buttons) return;
  if (isVideoIcon(obj)) {
    moveOnVideoIcon(obj, event);
  } else {
    ZQViewerCommon::clickableMouseMove_cb(data, canvas, obj, info);
  }
}

void ZQVPictureButton::_mouseUpCb(void* data, Evas* canvas, Evas_Object* obj, void* info) {
  if (!hasArguments(data, info)) return;
  auto* grid = static_cast<Evas_Object*>(data);
  Evas_Object* button = openButtonOf(grid);
  if (!button) return;
  // Whatever the button does may take the cell away.
  const ZQVWeakObject pressed(obj);
  if (!ZQVPressPoint::isMoving(obj)) {
    evas_object_smart_callback_call(button, "clicked", evas_object_data_get(grid, kBoundData));
  }
  if (!pressed.get()) return;
  if (isVideoIcon(obj)) {
    releaseVideoIcon(obj);
  } else {
    ZQViewerCommon::clickableReleaseCb(data, canvas, obj, info);
  }
}
