#include "Screen.h"

#include <X11/Xatom.h>
#include <X11/Xlib.h>
#include <X11/Xutil.h>

#include <memory>
#include <vector>

namespace {

struct CloseDisplay {
  void operator()(Display* display) const { XCloseDisplay(display); }
};
using DisplayOwner = std::unique_ptr<Display, CloseDisplay>;

constexpr long kMostValues = 1024;

/// A window's property, if its values have that many bits; Xlib keeps 32 bits in a long.
template <typename Values>
Values property(Display* display, Window window, const char* name, int bits) {
  Atom type = None;
  int format = 0;
  unsigned long count = 0, rest = 0;
  unsigned char* data = nullptr;
  XGetWindowProperty(display, window, XInternAtom(display, name, False), 0, kMostValues, False,
                     AnyPropertyType, &type, &format, &count, &rest, &data);
  Values result;
  if (format == bits) {
    const auto* values = reinterpret_cast<const typename Values::value_type*>(data);
    result.assign(values, values + count);
  }
  if (data) XFree(data);
  return result;
}

std::vector<unsigned long> numbers(Display* display, Window window, const char* name) {
  return property<std::vector<unsigned long>>(display, window, name, 32);
}

std::string text(Display* display, Window window, const char* name) {
  return property<std::string>(display, window, name, 8);
}

Window viewable(Display* display, const std::vector<unsigned long>& bottomToTop) {
  for (auto it = bottomToTop.rbegin(); it != bottomToTop.rend(); ++it) {
    XWindowAttributes attributes{};
    if (XGetWindowAttributes(display, *it, &attributes) && attributes.map_state == IsViewable) {
      return *it;
    }
  }
  return None;
}

/// A window may have been closed since it was listed.
int ignoreError(Display*, XErrorEvent*) {
  return 0;
}

}  // namespace

Area AppWindow::onScreen(const Area& canvas) const {
  const int right = area.x + area.width, bottom = area.y + area.height;
  switch (rotation) {
    case 90:
      return {area.x + canvas.y, bottom - canvas.x - canvas.width, canvas.height, canvas.width};
    case 180:
      return {right - canvas.x - canvas.width, bottom - canvas.y - canvas.height, canvas.width,
              canvas.height};
    case 270:
      return {right - canvas.y - canvas.height, area.y + canvas.x, canvas.height, canvas.width};
    default:
      return {area.x + canvas.x, area.y + canvas.y, canvas.width, canvas.height};
  }
}

std::optional<AppWindow> topWindow() {
  const DisplayOwner display(XOpenDisplay(nullptr));
  if (!display) return std::nullopt;
  XSetErrorHandler(ignoreError);
  const Window root = DefaultRootWindow(display.get());
  const Window top =
      viewable(display.get(), numbers(display.get(), root, "_NET_CLIENT_LIST_STACKING"));
  if (top == None) return std::nullopt;
  AppWindow window;
  window.title = text(display.get(), top, "_NET_WM_NAME");
  const auto pid = numbers(display.get(), top, "_NET_WM_PID");
  if (!pid.empty()) window.pid = static_cast<int>(pid[0]);
  const auto angle = numbers(display.get(), top, "_E_ILLUME_ROTATE_WINDOW_ANGLE");
  if (!angle.empty()) window.rotation = static_cast<int>(angle[0]);
  XWindowAttributes attributes{};
  Window child = None;
  if (!XGetWindowAttributes(display.get(), top, &attributes)) return std::nullopt;
  window.area.width = attributes.width;
  window.area.height = attributes.height;
  XTranslateCoordinates(display.get(), top, root, 0, 0, &window.area.x, &window.area.y, &child);
  return window;
}
