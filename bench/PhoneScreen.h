#pragma once

#include <X11/Xlib.h>
#include <X11/extensions/Xdamage.h>

#include <memory>

double nowMs();

/// The phone's screen, seen from outside: whoever is watched announces nothing.
class PhoneScreen {
 public:
  PhoneScreen();
  ~PhoneScreen();
  PhoneScreen(const PhoneScreen&) = delete;
  PhoneScreen& operator=(const PhoneScreen&) = delete;

  bool isOpen() const { return _display != nullptr; }
  Display* display() const { return _display; }
  int width() const;
  int height() const;

  /// Waits for the next change of what is shown; false when there is none until `endMs`.
  bool waitForChange(double endMs);
  /// On how many spots of a raster of 40 pixels is this colour to be seen now?
  int spotsOf(unsigned long colour);

  /// Asks the window on top for a sign of life, as a window manager does. Its main loop answers;
  /// the milliseconds until then, negative when there is no answer in time.
  double askForLife(double patienceMs);

 private:
  class Picture;

  Window _windowOnTop();
  bool _next(XEvent* event, double endMs);

  Display* _display = nullptr;
  Damage _damage = 0;
  int _damageEvent = 0;
  std::unique_ptr<Picture> _picture;
  long _lastPing = 0;
};
