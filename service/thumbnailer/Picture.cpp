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
constexpr char kQuality[] = "85";
constexpr guint32 kWhite = 0xffffff;
constexpr int kOpaque = 255;
constexpr int kCheckSize = 16;  // of a board whose squares are all white

/// A smaller copy; of a picture with clear parts also one on white, for JPEG has none.
Picture copied(const GdkPixbuf* picture, int width, int height) {
  if (!gdk_pixbuf_get_has_alpha(picture)) {
    return Picture(gdk_pixbuf_scale_simple(picture, width, height, GDK_INTERP_BILINEAR));
  }
  return Picture(gdk_pixbuf_composite_color_simple(picture, width, height, GDK_INTERP_BILINEAR,
                                                   kOpaque, kCheckSize, kWhite, kWhite));
}

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
  Picture copy;
  if (factor < 1.0 || gdk_pixbuf_get_has_alpha(picture)) {
    copy = copied(picture, std::max(1, static_cast<int>(width * factor)),
                  std::max(1, static_cast<int>(height * factor)));
    if (!copy) return false;
    picture = copy.get();
  }
  const std::string part = path + ".part";
  struct stat written;
  if (gdk_pixbuf_save(picture, part.c_str(), "jpeg", nullptr, "quality", kQuality, nullptr) &&
      stat(part.c_str(), &written) == 0 && written.st_size <= kMaxFileSize &&
      rename(part.c_str(), path.c_str()) == 0) {
    return true;
  }
  unlink(part.c_str());
  return false;
}

}  // namespace thumbnailer
