#pragma once

#include <app_control.h>

#include <memory>

namespace app_assist {

class WWindowController;

/// An application's life: derive, override, call start(). All operations run on the main loop.
class WApp {
 public:
  WApp(int argc, char** argv);
  virtual ~WApp();
  WApp(const WApp&) = delete;
  WApp& operator=(const WApp&) = delete;

  /// Before anything exists; false ends the process with a failure.
  virtual bool onStart();
  /// Build the window here. False: the main loop does not start, onTerminate still runs.
  virtual bool onCreate();
  /// After the main loop. Every view is destroyed before it runs; the window goes after it.
  virtual void onTerminate();
  virtual void onPause();
  virtual void onResume();
  /// One launch request; the handle is the framework's and valid only during the call.
  virtual void onAppControl(app_control_h request);

  /// Runs the application; returns the process's exit status.
  int start(int argc, char** argv);

  /// Takes ownership of the window controller.
  void attachWindowController(WWindowController* window);
  WWindowController* getWindowController() const;

  /// The application of this process, or null outside its life.
  static WApp* getInstance();

 private:
  struct Private;
  std::unique_ptr<Private> _d;
};

}  // namespace app_assist
