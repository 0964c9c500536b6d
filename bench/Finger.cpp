#include "Finger.h"

#include <X11/extensions/XTest.h>

void Finger::moveTo(int x, int y) {
  XTestFakeMotionEvent(_display, -1, x, y, CurrentTime);
  XFlush(_display);
}

void Finger::press() {
  _button(1, true);
}

void Finger::lift() {
  _button(1, false);
}

void Finger::wheelDown() {
  _button(5, true);
  _button(5, false);
}

void Finger::key(const char* name) {
  const KeyCode code = XKeysymToKeycode(_display, XStringToKeysym(name));
  XTestFakeKeyEvent(_display, code, True, CurrentTime);
  XTestFakeKeyEvent(_display, code, False, CurrentTime);
  XFlush(_display);
}

void Finger::_button(unsigned int button, bool isDown) {
  XTestFakeButtonEvent(_display, button, isDown, CurrentTime);
  XFlush(_display);
}
