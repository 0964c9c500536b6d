#include "PhoneScreen.h"

#include <X11/Xatom.h>
#include <X11/Xutil.h>
#include <X11/extensions/XShm.h>
#include <poll.h>
#include <sys/ipc.h>
#include <sys/shm.h>

#include <cstdlib>
#include <ctime>

namespace {

constexpr int kRaster = 40;
constexpr int kTolerance = 24;

bool isNear(unsigned long pixel, unsigned long colour) {
  for (int shift = 0; shift <= 16; shift += 8) {
    const int difference =
        static_cast<int>(pixel >> shift & 0xff) - static_cast<int>(colour >> shift & 0xff);
    if (abs(difference) > kTolerance) return false;
  }
  return true;
}

}  // namespace

double nowMs() {
  timespec now{};
  clock_gettime(CLOCK_MONOTONIC, &now);
  return static_cast<double>(now.tv_sec) * 1e3 + static_cast<double>(now.tv_nsec) / 1e6;
}

/// A copy of the screen in memory shared with the X server: looking costs a millisecond, so it
/// takes little from what is watched.
class PhoneScreen::Picture {
 public:
  explicit Picture(Display* display) : _display(display) {
    const int screen = DefaultScreen(display);
    _image = XShmCreateImage(display, DefaultVisual(display, screen), DefaultDepth(display, screen),
                             ZPixmap, nullptr, &_memory, DisplayWidth(display, screen),
                             DisplayHeight(display, screen));
    const size_t bytes = static_cast<size_t>(_image->bytes_per_line) * _image->height;
    _memory.shmid = shmget(IPC_PRIVATE, bytes, IPC_CREAT | 0600);
    _memory.shmaddr = _image->data = static_cast<char*>(shmat(_memory.shmid, nullptr, 0));
    _memory.readOnly = False;
    XShmAttach(display, &_memory);
    XSync(display, False);
    shmctl(_memory.shmid, IPC_RMID, nullptr);
  }
  ~Picture() {
    XShmDetach(_display, &_memory);
    XDestroyImage(_image);
    shmdt(_memory.shmaddr);
  }
  Picture(const Picture&) = delete;
  Picture& operator=(const Picture&) = delete;

  int spotsOf(unsigned long colour) {
    if (!XShmGetImage(_display, DefaultRootWindow(_display), _image, 0, 0, AllPlanes)) return 0;
    int spots = 0;
    for (int y = kRaster / 2; y < _image->height; y += kRaster) {
      for (int x = kRaster / 2; x < _image->width; x += kRaster) {
        if (isNear(XGetPixel(_image, x, y), colour)) ++spots;
      }
    }
    return spots;
  }

 private:
  Display* _display;
  XShmSegmentInfo _memory{};
  XImage* _image;
};

PhoneScreen::PhoneScreen() : _display(XOpenDisplay(nullptr)) {
  if (!_display) return;
  int errorBase = 0;
  XDamageQueryExtension(_display, &_damageEvent, &errorBase);
  _damage = XDamageCreate(_display, DefaultRootWindow(_display), XDamageReportNonEmpty);
  XSelectInput(_display, DefaultRootWindow(_display), SubstructureNotifyMask);
  XSync(_display, False);
}

PhoneScreen::~PhoneScreen() {
  _picture.reset();
  if (_display) XCloseDisplay(_display);
}

int PhoneScreen::width() const {
  return DisplayWidth(_display, DefaultScreen(_display));
}

int PhoneScreen::height() const {
  return DisplayHeight(_display, DefaultScreen(_display));
}

bool PhoneScreen::waitForChange(double endMs) {
  XEvent event;
  while (_next(&event, endMs)) {
    if (event.type != _damageEvent + XDamageNotify) continue;
    XDamageSubtract(_display, _damage, None, None);
    XFlush(_display);
    return true;
  }
  return false;
}

int PhoneScreen::spotsOf(unsigned long colour) {
  if (!_picture) _picture = std::make_unique<Picture>(_display);
  return _picture->spotsOf(colour);
}

double PhoneScreen::askForLife(double patienceMs) {
  const Window window = _windowOnTop();
  if (!window) return -1;
  const Atom protocols = XInternAtom(_display, "WM_PROTOCOLS", False);
  XEvent ping{};
  ping.xclient.type = ClientMessage;
  ping.xclient.window = window;
  ping.xclient.message_type = protocols;
  ping.xclient.format = 32;
  ping.xclient.data.l[0] = static_cast<long>(XInternAtom(_display, "_NET_WM_PING", False));
  ping.xclient.data.l[1] = ++_lastPing;
  ping.xclient.data.l[2] = static_cast<long>(window);
  const double begin = nowMs();
  XSendEvent(_display, window, False, NoEventMask, &ping);
  XFlush(_display);
  XEvent event;
  while (_next(&event, begin + patienceMs)) {
    if (event.type == ClientMessage && event.xclient.message_type == protocols &&
        event.xclient.data.l[1] == _lastPing) {
      return nowMs() - begin;
    }
  }
  return -1;
}

Window PhoneScreen::_windowOnTop() {
  Atom type = 0;
  int format = 0;
  unsigned long count = 0, rest = 0;
  unsigned char* data = nullptr;
  XGetWindowProperty(_display, DefaultRootWindow(_display),
                     XInternAtom(_display, "_NET_ACTIVE_WINDOW", False), 0, 1, False, XA_WINDOW,
                     &type, &format, &count, &rest, &data);
  const Window window = data && count ? *reinterpret_cast<Window*>(data) : 0;
  if (data) XFree(data);
  return window;
}

bool PhoneScreen::_next(XEvent* event, double endMs) {
  while (!XPending(_display)) {
    const double left = endMs - nowMs();
    if (left <= 0) return false;
    pollfd source{ConnectionNumber(_display), POLLIN, 0};
    poll(&source, 1, static_cast<int>(left) + 1);
  }
  XNextEvent(_display, event);
  return true;
}
