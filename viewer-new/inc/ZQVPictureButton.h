#pragma once

#include <Elementary.h>

/// A full-view picture that acts for the button which its grid is bound to, while that button opens
/// the file. The callbacks' data is the grid.
class ZQVPictureButton {
 public:
  /// The play mark's background, which shrinks while it is pressed.
  static const char* const kVideoIcon;

  /// Keys of the grid's object data: the button, and the data of its "clicked".
  static constexpr const char* kBoundButton = "bindedObject";
  static constexpr const char* kBoundData = "bindedObjectClickedCbData";

  static void _mouseDownCb(void* data, Evas* canvas, Evas_Object* obj, void* info);
  static void _mouseMoveCb(void* data, Evas* canvas, Evas_Object* obj, void* info);
  static void _mouseUpCb(void* data, Evas* canvas, Evas_Object* obj, void* info);
};
