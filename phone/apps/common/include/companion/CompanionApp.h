#pragma once

#include <app_assist.h>

#include <string>

namespace companion {

/// The layouts and styles of the phone's own applications.
std::string themeFile();

/// A picture of this application.
std::string imageFile(const char* name);

/// An application of the phone: one window, made when it is first needed, and its pages.
class CompanionApp : public app_assist::WApp {
 public:
  using WApp::WApp;

 protected:
  /// The pages; makes the window the first time.
  app_assist::WNaviframeController* pages();
  bool hasWindow() const { return getWindowController() != nullptr; }
  /// Before the other windows.
  void raise();
  /// Behind the other windows.
  void lower();

  /// The user wants to leave the last page. True keeps it; by default the application ends.
  virtual bool onLeave();

 private:
  app_assist::WNaviframeController* _pages = nullptr;
};

}  // namespace companion
