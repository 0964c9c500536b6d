// What the X screen shows, seen from outside: nobody announces anything to this program.
//
// screen_watch colour RRGGBB CELLS   waits until that colour fills CELLS spots of a 40-pixel raster
//                                    of the screen; prints the time (CLOCK_MONOTONIC, ms) of the
//                                    look that saw it
// screen_watch frames SECONDS        counts the screen's changes; prints "frames N longest MS
//                                    late N" (late: more than 33 ms after the one before)

#include <X11/Xlib.h>
#include <X11/Xutil.h>
#include <X11/extensions/Xdamage.h>
#include <poll.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <memory>

namespace {

constexpr int kRaster = 40;
constexpr int kTolerance = 24;
constexpr double kLateMs = 33.0;
constexpr double kTimeoutMs = 60000.0;

struct CloseDisplay {
  void operator()(Display* display) const { XCloseDisplay(display); }
};
using DisplayPtr = std::unique_ptr<Display, CloseDisplay>;

double nowMs() {
  timespec now{};
  clock_gettime(CLOCK_MONOTONIC, &now);
  return now.tv_sec * 1e3 + now.tv_nsec / 1e6;
}

bool isNear(unsigned long pixel, unsigned long colour) {
  for (int shift = 0; shift <= 16; shift += 8) {
    const int difference =
        static_cast<int>(pixel >> shift & 0xff) - static_cast<int>(colour >> shift & 0xff);
    if (abs(difference) > kTolerance) return false;
  }
  return true;
}

int spotsOf(Display* display, unsigned long colour) {
  const int screen = DefaultScreen(display);
  const int width = DisplayWidth(display, screen);
  const int height = DisplayHeight(display, screen);
  XImage* image =
      XGetImage(display, DefaultRootWindow(display), 0, 0, width, height, AllPlanes, ZPixmap);
  if (!image) return 0;
  int spots = 0;
  for (int y = kRaster / 2; y < height; y += kRaster) {
    for (int x = kRaster / 2; x < width; x += kRaster) {
      if (isNear(XGetPixel(image, x, y), colour)) ++spots;
    }
  }
  XDestroyImage(image);
  return spots;
}

int watchColour(Display* display, unsigned long colour, int wanted) {
  const double begin = nowMs();
  while (nowMs() - begin < kTimeoutMs) {
    const double look = nowMs();
    if (spotsOf(display, colour) >= wanted) {
      printf("%.1f\n", look);
      return 0;
    }
    timespec pause{0, 2000000};
    nanosleep(&pause, nullptr);
  }
  fprintf(stderr, "screen_watch: the colour did not come\n");
  return 1;
}

bool waitForEvent(Display* display, double milliseconds) {
  if (XPending(display)) return true;
  pollfd source{ConnectionNumber(display), POLLIN, 0};
  return milliseconds > 0 && poll(&source, 1, static_cast<int>(milliseconds) + 1) > 0;
}

int watchFrames(Display* display, double seconds) {
  int eventBase = 0;
  int errorBase = 0;
  if (!XDamageQueryExtension(display, &eventBase, &errorBase)) return 1;
  const Damage damage = XDamageCreate(display, DefaultRootWindow(display), XDamageReportNonEmpty);
  XSync(display, False);
  puts("watching");
  fflush(stdout);

  int frames = 0;
  int late = 0;
  double longest = 0;
  double last = 0;
  const double end = nowMs() + seconds * 1e3;
  while (nowMs() < end) {
    if (!waitForEvent(display, end - nowMs())) continue;
    XEvent event;
    XNextEvent(display, &event);
    if (event.type != eventBase + XDamageNotify) continue;
    XDamageSubtract(display, damage, None, None);
    XFlush(display);
    const double now = nowMs();
    // Several rectangles of one frame arrive within a moment.
    if (last > 0 && now - last < 4) continue;
    if (last > 0 && now - last > longest) longest = now - last;
    if (last > 0 && now - last > kLateMs) ++late;
    last = now;
    ++frames;
  }
  printf("frames %d longest %.1f late %d\n", frames, longest, late);
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  DisplayPtr display(XOpenDisplay(nullptr));
  if (!display) {
    fprintf(stderr, "screen_watch: no display\n");
    return 1;
  }
  if (argc == 4 && !strcmp(argv[1], "colour")) {
    return watchColour(display.get(), strtoul(argv[2], nullptr, 16), atoi(argv[3]));
  }
  if (argc == 3 && !strcmp(argv[1], "frames")) return watchFrames(display.get(), atof(argv[2]));
  fprintf(stderr, "usage: screen_watch colour RRGGBB CELLS | frames SECONDS\n");
  return 2;
}
