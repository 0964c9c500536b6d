#include "Picture.h"

#include <gdk-pixbuf/gdk-pixbuf.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <memory>
#include <ostream>
#include <vector>

namespace phone {
namespace {

struct Unref {
  void operator()(GdkPixbuf* picture) const { g_object_unref(picture); }
};
using Picture = std::unique_ptr<GdkPixbuf, Unref>;

constexpr int kTolerance = 24;
constexpr int kBitsPerSample = 8;

void append32(std::string& bytes, unsigned value) {
  for (int shift : {24, 16, 8, 0}) bytes += static_cast<char>(value >> shift);
}

bool endsWith(const std::string& text, const std::string& end) {
  return text.size() >= end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

}  // namespace

bool Colour::isAbout(const Colour& other) const {
  return std::abs(red - other.red) <= kTolerance && std::abs(green - other.green) <= kTolerance &&
         std::abs(blue - other.blue) <= kTolerance;
}

bool Colour::operator==(const Colour& other) const {
  return red == other.red && green == other.green && blue == other.blue;
}

std::ostream& operator<<(std::ostream& out, const Colour& colour) {
  return out << '(' << colour.red << ' ' << colour.green << ' ' << colour.blue << ')';
}

std::string makePicture(const Phone& phone, const std::string& name, const Colour& colour,
                        int width, int height) {
  std::string path = phone.makeFile(name, 0);
  const Picture picture(gdk_pixbuf_new(GDK_COLORSPACE_RGB, FALSE, kBitsPerSample, width, height));
  gdk_pixbuf_fill(picture.get(), static_cast<guint32>(colour.red) << 24 |
                                     static_cast<guint32>(colour.green) << 16 |
                                     static_cast<guint32>(colour.blue) << 8 | 0xff);
  EXPECT_TRUE(gdk_pixbuf_save(picture.get(), path.c_str(), endsWith(name, ".jpg") ? "jpeg" : "png",
                              nullptr, nullptr));
  return path;
}

std::string makeStripes(const Phone& phone, const std::string& name) {
  constexpr int kWidth = 4000;
  constexpr int kHeight = 3000;
  constexpr int kPeriod = 13;
  std::string path = phone.makeFile(name, 0);
  const Picture picture(gdk_pixbuf_new(GDK_COLORSPACE_RGB, FALSE, kBitsPerSample, kWidth, kHeight));
  gdk_pixbuf_fill(picture.get(), 0xffffffff);
  for (int x = 0; x + kPeriod <= kWidth; x += kPeriod) {
    const Picture stripe(gdk_pixbuf_new_subpixbuf(picture.get(), x, 0, kPeriod / 2, kHeight));
    gdk_pixbuf_fill(stripe.get(), 0x000000ff);
  }
  EXPECT_TRUE(gdk_pixbuf_save(picture.get(), path.c_str(), "jpeg", nullptr, nullptr));
  return path;
}

std::string makeAnimation(const Phone& phone, const std::string& name) {
  std::string path = phone.makeFile(name, 0);
  const bool isGif = endsWith(name, ".gif");
  const std::string frames = std::string(
                                 "color=red:s=400x300:r=2:d=1[red];"
                                 "color=blue:s=400x300:r=2:d=1[blue];"
                                 "[red][blue]concat=n=2,format=") +
                             (isGif ? "rgb8" : "yuv420p");
  const std::vector<const char*> command = {"ffmpeg",
                                            "-v",
                                            "error",
                                            "-y",
                                            "-filter_complex",
                                            frames.c_str(),
                                            "-c:v",
                                            isGif ? "gif" : "libwebp_anim",
                                            "-loop",
                                            "0",
                                            path.c_str(),
                                            nullptr};
  EXPECT_TRUE(g_spawn_sync(nullptr, const_cast<char**>(command.data()), nullptr,
                           G_SPAWN_SEARCH_PATH, nullptr, nullptr, nullptr, nullptr, nullptr,
                           nullptr));
  return path;
}

std::string pngHeader(unsigned width, unsigned height) {
  std::string bytes("\x89PNG\r\n\x1a\n\0\0\0\rIHDR", 16);
  append32(bytes, width);
  append32(bytes, height);
  bytes += std::string("\x08\x02\0\0\0\0\0\0\0", 9);
  return bytes;
}

std::string pixelsOf(const Phone& phone, const Area& area) {
  const std::string file = phone.folder() + "/screen.png";
  phone({"screenshot", file});
  const Picture screen(gdk_pixbuf_new_from_file(file.c_str(), nullptr));
  if (!screen || area.x < 0 || area.y < 0 || area.right() > gdk_pixbuf_get_width(screen.get()) ||
      area.bottom() > gdk_pixbuf_get_height(screen.get())) {
    return {};
  }
  const int perPixel = gdk_pixbuf_get_n_channels(screen.get());
  const guchar* row = gdk_pixbuf_read_pixels(screen.get()) + ptrdiff_t{area.x} * perPixel +
                      ptrdiff_t{area.y} * gdk_pixbuf_get_rowstride(screen.get());
  std::string pixels;
  for (int y = 0; y < area.height; y++, row += gdk_pixbuf_get_rowstride(screen.get())) {
    pixels.append(reinterpret_cast<const char*>(row),
                  static_cast<size_t>(area.width) * static_cast<size_t>(perPixel));
  }
  return pixels;
}

int contrastIn(const Phone& phone, const Area& row) {
  const std::string pixels = pixelsOf(phone, row);
  if (pixels.empty()) return 0;
  const size_t perPixel = pixels.size() / static_cast<size_t>(row.width);
  int differences = 0;
  for (size_t i = perPixel; i < pixels.size(); i += perPixel) {
    differences += std::abs(static_cast<unsigned char>(pixels[i]) -
                            static_cast<unsigned char>(pixels[i - perPixel]));
  }
  return differences / row.width;
}

Colour colourAt(const Phone& phone, int x, int y) {
  const std::string pixel = pixelsOf(phone, {x, y, 1, 1});
  const auto part = [&pixel](size_t i) {
    return i < pixel.size() ? static_cast<unsigned char>(pixel[i]) : 0;
  };
  return {part(0), part(1), part(2)};
}

Colour colourOf(const Phone& phone, const std::string& name) {
  const Tree tree = phone.tree();
  const Widget* widget = tree.named(name);
  if (!widget) return {};
  return colourAt(phone, widget->area.x + widget->area.width / 2,
                  widget->area.y + widget->area.height / 2);
}

}  // namespace phone
