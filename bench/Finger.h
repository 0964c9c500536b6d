#pragma once

#include <X11/Xlib.h>

/// Input as a person gives it.
class Finger {
 public:
  explicit Finger(Display* display) : _display(display) {}

  void moveTo(int x, int y);
  void press();
  void lift();
  void wheelDown();
  void key(const char* name);

 private:
  void _button(unsigned int button, bool isDown);

  Display* _display;
};
