#include "Picture.h"

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>

namespace thumbnailer {
namespace {

constexpr int kMaxSide = 8192;
constexpr std::int64_t kMaxPixels = 40'000'000;
// Larger ones are refused by the phones.
constexpr off_t kMaxFileSize = 8 << 20;
// The next levels save a few percent of size and cost twice the time.
constexpr char kCompression[] = "1";

}  // namespace

Picture loadPicture(const std::string& path) {
  int width = 0;
  int height = 0;
  if (!gdk_pixbuf_get_file_info(path.c_str(), &width, &height)) return nullptr;
  if (width < 1 || height < 1 || width > kMaxSide || height > kMaxSide ||
      std::int64_t{width} * height > kMaxPixels) {
    return nullptr;
  }
  // The loader would enlarge a small picture.
  const int longest = std::min(std::max(width, height), kBigPx);
  const Picture decoded(
      gdk_pixbuf_new_from_file_at_scale(path.c_str(), longest, longest, TRUE, nullptr));
  if (!decoded) return nullptr;
  return Picture(gdk_pixbuf_apply_embedded_orientation(decoded.get()));
}

bool savePicture(GdkPixbuf* picture, int longest, const std::string& path) {
  const int width = gdk_pixbuf_get_width(picture);
  const int height = gdk_pixbuf_get_height(picture);
  const double factor = std::min(1.0, static_cast<double>(longest) / std::max(width, height));
  Picture scaled;
  if (factor < 1.0) {
    scaled.reset(gdk_pixbuf_scale_simple(picture, std::max(1, static_cast<int>(width * factor)),
                                         std::max(1, static_cast<int>(height * factor)),
                                         GDK_INTERP_BILINEAR));
    if (!scaled) return false;
    picture = scaled.get();
  }
  const std::string part = path + ".part";
  struct stat written;
  if (gdk_pixbuf_save(picture, part.c_str(), "png", nullptr, "compression", kCompression,
                      nullptr) &&
      stat(part.c_str(), &written) == 0 && written.st_size <= kMaxFileSize &&
      rename(part.c_str(), path.c_str()) == 0) {
    return true;
  }
  unlink(part.c_str());
  return false;
}

}  // namespace thumbnailer
