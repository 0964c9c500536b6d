#include "MaskedPicture.h"

#include <common/Owned.h>
#include <dlog.h>
#include <gdk-pixbuf/gdk-pixbuf.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace theme {
namespace {

constexpr int kMaxSide = 4096;
/// A picture that claims more is not decoded at all.
constexpr int64_t kMaxPixels = 100'000'000;

using OwnedPixbuf = common::OwnedObject<GdkPixbuf>;

Pixels pixelsOf(const GdkPixbuf* pixbuf) {
  return {gdk_pixbuf_read_pixels(pixbuf),
          {gdk_pixbuf_get_width(pixbuf), gdk_pixbuf_get_height(pixbuf)},
          static_cast<size_t>(gdk_pixbuf_get_rowstride(pixbuf)),
          gdk_pixbuf_get_n_channels(pixbuf)};
}

/// What the header says, before anything is decoded; the format only for a usable size.
GdkPixbufFormat* usableFormat(const char* path, Size* size) {
  if (!path) return nullptr;
  GdkPixbufFormat* format = gdk_pixbuf_get_file_info(path, &size->width, &size->height);
  const bool usable = format && size->width > 0 && size->height > 0 &&
                      static_cast<int64_t>(size->width) * size->height <= kMaxPixels;
  return usable ? format : nullptr;
}

/// Upright, and at least as large as `size` in both directions.
OwnedPixbuf loadCovering(const char* path, Size size) {
  Size own{};
  if (!usableFormat(path, &own)) return nullptr;
  // Turning may exchange the sides, so both have to cover the longer one.
  const double factor =
      static_cast<double>(std::max(size.width, size.height)) / std::min(own.width, own.height);
  const int width = static_cast<int>(std::ceil(own.width * factor));
  const int height = static_cast<int>(std::ceil(own.height * factor));
  if (static_cast<int64_t>(width) * height > kMaxPixels) return nullptr;
  const OwnedPixbuf loaded(gdk_pixbuf_new_from_file_at_scale(path, width, height, FALSE, nullptr));
  return OwnedPixbuf(loaded ? gdk_pixbuf_apply_embedded_orientation(loaded.get()) : nullptr);
}

OwnedPixbuf loadFilling(const char* path, Size size) {
  const OwnedPixbuf source = loadCovering(path, size);
  if (!source) return nullptr;
  OwnedPixbuf result(gdk_pixbuf_new(GDK_COLORSPACE_RGB, gdk_pixbuf_get_has_alpha(source.get()), 8,
                                    size.width, size.height));
  if (!result) return nullptr;
  const double width = gdk_pixbuf_get_width(source.get());
  const double height = gdk_pixbuf_get_height(source.get());
  const double factor = std::max(size.width / width, size.height / height);
  gdk_pixbuf_scale(source.get(), result.get(), 0, 0, size.width, size.height,
                   (size.width - width * factor) / 2, (size.height - height * factor) / 2, factor,
                   factor, GDK_INTERP_BILINEAR);
  return result;
}

OwnedPixbuf loadMask(const char* path) {
  Size own{};
  GdkPixbufFormat* format = usableFormat(path, &own);
  if (!format) return nullptr;
  const common::OwnedText name(gdk_pixbuf_format_get_name(format));
  if (g_strcmp0(name.get(), "png") != 0) return nullptr;
  return OwnedPixbuf(gdk_pixbuf_new_from_file(path, nullptr));
}

bool isUsable(Size size, int maskX, int maskY) {
  return size.width > 0 && size.height > 0 && size.width <= kMaxSide && size.height <= kMaxSide &&
         maskX >= -kMaxSide && maskY >= -kMaxSide && maskX <= kMaxSide && maskY <= kMaxSide;
}

}  // namespace

uint32_t* maskedPicture(const char* picture, const char* mask, Size size, int maskX, int maskY) {
  const OwnedPixbuf shape = isUsable(size, maskX, maskY) ? loadMask(mask) : nullptr;
  const OwnedPixbuf source = shape ? loadFilling(picture, size) : nullptr;
  if (!source) {
    dlog_print(DLOG_ERROR, "THEME", "%s cannot be masked by %s", picture ? picture : "(null)",
               mask ? mask : "(null)");
    return nullptr;
  }
  auto* result = static_cast<uint32_t*>(
      malloc(sizeof(uint32_t) * static_cast<size_t>(size.width) * size.height));
  if (result) maskPixels(pixelsOf(source.get()), pixelsOf(shape.get()), maskX, maskY, result);
  return result;
}

}  // namespace theme
