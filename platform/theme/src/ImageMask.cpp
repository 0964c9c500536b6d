#include "ImageMask.h"

#include <gdk-pixbuf/gdk-pixbuf.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <memory>

namespace {

constexpr int kLongestSide = 8192;
constexpr int64_t kMostPixels = 40000000;

struct Unref {
  void operator()(GdkPixbuf* pixbuf) const { g_object_unref(pixbuf); }
};
using Pixbuf = std::unique_ptr<GdkPixbuf, Unref>;

bool isReasonable(int width, int height) {
  return width > 0 && height > 0 && width <= kLongestSide && height <= kLongestSide &&
         static_cast<int64_t>(width) * height <= kMostPixels;
}

/// The size of a picture file, from its header; false for what may not be loaded.
bool sizeOf(const char* path, int* width, int* height) {
  return path && gdk_pixbuf_get_file_info(path, width, height) && isReasonable(*width, *height);
}

Pixbuf load(const char* path, int width, int height) {
  Pixbuf file(gdk_pixbuf_new_from_file_at_scale(path, width, height, FALSE, nullptr));
  if (!file) return nullptr;
  return Pixbuf(gdk_pixbuf_add_alpha(file.get(), FALSE, 0, 0, 0));
}

Pixels pixelsOf(GdkPixbuf* pixbuf, int left, int top, int width, int height) {
  Pixels pixels{width, height, std::vector<uint8_t>(static_cast<size_t>(width) * height * 4)};
  const guint8* rows = gdk_pixbuf_read_pixels(pixbuf);
  const int stride = gdk_pixbuf_get_rowstride(pixbuf);
  for (int y = 0; y < height; ++y) {
    memcpy(&pixels.rgba[static_cast<size_t>(y) * width * 4], rows + (top + y) * stride + left * 4,
           static_cast<size_t>(width) * 4);
  }
  return pixels;
}

/// The middle of the picture, scaled so that it fills w x h.
bool loadFilling(const char* path, int w, int h, Pixels* pixels) {
  int width = 0;
  int height = 0;
  if (!sizeOf(path, &width, &height)) return false;
  const double scale = std::max(static_cast<double>(w) / width, static_cast<double>(h) / height);
  const int scaledWidth = std::max(w, static_cast<int>(width * scale));
  const int scaledHeight = std::max(h, static_cast<int>(height * scale));
  if (!isReasonable(scaledWidth, scaledHeight)) return false;
  const Pixbuf pixbuf = load(path, scaledWidth, scaledHeight);
  if (!pixbuf) return false;
  *pixels = pixelsOf(pixbuf.get(), (scaledWidth - w) / 2, (scaledHeight - h) / 2, w, h);
  return true;
}

bool loadMask(const char* path, Pixels* pixels) {
  int width = 0;
  int height = 0;
  if (!sizeOf(path, &width, &height)) return false;
  const Pixbuf pixbuf = load(path, width, height);
  if (!pixbuf) return false;
  *pixels = pixelsOf(pixbuf.get(), 0, 0, width, height);
  return true;
}

uint32_t premultiplied(const uint8_t* rgba, uint32_t maskAlpha) {
  const uint32_t alpha = rgba[3] * maskAlpha / 255;
  const auto share = [alpha](uint32_t value) { return value * alpha / 255; };
  return alpha << 24 | share(rgba[0]) << 16 | share(rgba[1]) << 8 | share(rgba[2]);
}

}  // namespace

std::vector<uint32_t> maskPixels(const Pixels& image, const Pixels& mask, int x, int y) {
  std::vector<uint32_t> result(static_cast<size_t>(image.width) * image.height);
  for (int row = 0; row < image.height; ++row) {
    for (int column = 0; column < image.width; ++column) {
      const int64_t maskRow = static_cast<int64_t>(row) - y;
      const int64_t maskColumn = static_cast<int64_t>(column) - x;
      const bool inside =
          maskRow >= 0 && maskRow < mask.height && maskColumn >= 0 && maskColumn < mask.width;
      const size_t at = static_cast<size_t>(row) * image.width + column;
      const uint32_t alpha = inside ? mask.rgba[(maskRow * mask.width + maskColumn) * 4 + 3] : 0;
      result[at] = premultiplied(&image.rgba[at * 4], alpha);
    }
  }
  return result;
}

uint32_t* maskImage(const char* image, const char* mask, int w, int h, int x, int y) {
  Pixels picture;
  Pixels through;
  if (!isReasonable(w, h) || !loadFilling(image, w, h, &picture) || !loadMask(mask, &through)) {
    return nullptr;
  }
  const std::vector<uint32_t> result = maskPixels(picture, through, x, y);
  const size_t bytes = result.size() * sizeof(uint32_t);
  auto* block = static_cast<uint32_t*>(malloc(bytes));
  if (block) memcpy(block, result.data(), bytes);
  return block;
}
