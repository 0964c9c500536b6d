// phone-screen: writes what the screen shows to standard output, as PNG.

#include <X11/Xlib.h>
#include <X11/Xutil.h>
#include <gdk-pixbuf/gdk-pixbuf.h>
#include <unistd.h>

#include <cstdio>
#include <memory>

namespace {

struct CloseDisplay {
  void operator()(Display* display) const { XCloseDisplay(display); }
};
struct DestroyImage {
  void operator()(XImage* image) const { XDestroyImage(image); }
};
using DisplayOwner = std::unique_ptr<Display, CloseDisplay>;
using ImageOwner = std::unique_ptr<XImage, DestroyImage>;
using PixbufOwner = std::unique_ptr<GdkPixbuf, decltype(&g_object_unref)>;

ImageOwner grab(Display* display) {
  XWindowAttributes root{};
  XGetWindowAttributes(display, DefaultRootWindow(display), &root);
  return ImageOwner(XGetImage(display, DefaultRootWindow(display), 0, 0, root.width, root.height,
                              AllPlanes, ZPixmap));
}

guchar channel(unsigned long pixel, unsigned long mask) {
  return static_cast<guchar>((pixel & mask) * 255 / mask);
}

PixbufOwner convert(XImage* image) {
  PixbufOwner pixbuf(gdk_pixbuf_new(GDK_COLORSPACE_RGB, FALSE, 8, image->width, image->height),
                     g_object_unref);
  guchar* const pixels = gdk_pixbuf_get_pixels(pixbuf.get());
  const int stride = gdk_pixbuf_get_rowstride(pixbuf.get());
  for (int y = 0; y < image->height; y++) {
    guchar* out = pixels + static_cast<ptrdiff_t>(y) * stride;
    for (int x = 0; x < image->width; x++) {
      const unsigned long pixel = XGetPixel(image, x, y);
      *out++ = channel(pixel, image->red_mask);
      *out++ = channel(pixel, image->green_mask);
      *out++ = channel(pixel, image->blue_mask);
    }
  }
  return pixbuf;
}

gboolean writeOut(const gchar* data, gsize size, GError**, gpointer) {
  return fwrite(data, 1, size, stdout) == size;
}

int fail(const char* why) {
  fprintf(stderr, "phone-screen: %s\n", why);
  return 1;
}

}  // namespace

int main() {
  const DisplayOwner display(XOpenDisplay(nullptr));
  if (!display) return fail("there is no screen");
  const ImageOwner image = grab(display.get());
  if (!image) return fail("the screen cannot be read");
  const PixbufOwner pixbuf = convert(image.get());
  if (!gdk_pixbuf_save_to_callback(pixbuf.get(), writeOut, nullptr, "png", nullptr, "compression",
                                   "3", nullptr) ||
      fflush(stdout) != 0) {
    return fail("the picture cannot be written");
  }
  return 0;
}
