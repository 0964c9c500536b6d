#pragma once

#include <Elementary.h>

#include <memory>

namespace app_assist {

class WViewController;

/// The application's window: status strip, rotation from the orientation sensor, back key.
class WWindowController {
 public:
  WWindowController(const char* name, Elm_Win_Type type);
  virtual ~WWindowController();
  WWindowController(const WWindowController&) = delete;
  WWindowController& operator=(const WWindowController&) = delete;

  /// The window; created by WApp::attachWindowController, null before.
  virtual Evas_Object* getEvasObj();
  /// The controller given to attachBaseViewController, borrowed.
  virtual WViewController* getBaseViewController();

  /// Creates the base view in the window and takes ownership of its controller.
  void attachBaseViewController(WViewController* base);

 private:
  friend class WApp;
  friend class WContentViewController;
  friend class WPopupController;
  struct Private;
  std::unique_ptr<Private> _d;
};

}  // namespace app_assist
