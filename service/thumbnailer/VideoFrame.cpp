#include <libffmpegthumbnailer/videothumbnailerc.h>

#include <array>
#include <cstdio>
#include <cstring>

#include "Picture.h"

namespace thumbnailer {
namespace {

struct DestroyThumbnailer {
  void operator()(video_thumbnailer* thumbnailer) const { video_thumbnailer_destroy(thumbnailer); }
};
struct DestroyImage {
  void operator()(image_data* image) const { video_thumbnailer_destroy_image_data(image); }
};
struct CloseFile {
  void operator()(FILE* file) const { fclose(file); }
};

// Play lists and other texts that make a decoder open further files are no videos here, whatever
// their sender calls them.
bool looksLikeVideo(const std::string& path) {
  struct Magic {
    std::size_t offset;
    const char* bytes;
    std::size_t length;
  };
  static constexpr std::array<Magic, 11> magics = {{
      {4, "ftyp", 4},              // MP4, QuickTime, 3GP
      {4, "moov", 4},              // older QuickTime
      {4, "mdat", 4},              // the same, recorded on the fly
      {0, "\x1a\x45\xdf\xa3", 4},  // Matroska, WebM
      {8, "AVI ", 4},
      {0, "OggS", 4},
      {0, "FLV\x01", 4},
      {0, "\x30\x26\xb2\x75", 4},  // ASF, WMV
      {0, "\x00\x00\x01\xba", 4},  // MPEG program stream
      {0, "\x00\x00\x01\xb3", 4},  // MPEG video
      {0, "\x47", 1},              // MPEG transport stream
  }};
  std::array<char, 16> head{};
  const std::unique_ptr<FILE, CloseFile> file(fopen(path.c_str(), "rbe"));
  if (!file || fread(head.data(), 1, head.size(), file.get()) != head.size()) return false;
  for (const Magic& magic : magics) {
    if (memcmp(head.data() + magic.offset, magic.bytes, magic.length) == 0) return true;
  }
  return false;
}

}  // namespace

Picture loadVideoFrame(const std::string& path) {
  if (!looksLikeVideo(path)) return nullptr;
  const std::unique_ptr<video_thumbnailer, DestroyThumbnailer> thumbnailer(
      video_thumbnailer_create());
  const std::unique_ptr<image_data, DestroyImage> image(video_thumbnailer_create_image_data());
  if (!thumbnailer || !image) return nullptr;
  thumbnailer->thumbnail_image_type = Rgb;
  // Nothing asked for is the size of the video itself.
  video_thumbnailer_set_size(thumbnailer.get(), 0, 0);
  if (video_thumbnailer_generate_thumbnail_to_buffer(thumbnailer.get(), path.c_str(),
                                                     image.get()) != 0) {
    return nullptr;
  }
  const Picture frame(gdk_pixbuf_new_from_data(image->image_data_ptr, GDK_COLORSPACE_RGB, FALSE, 8,
                                               image->image_data_width, image->image_data_height,
                                               image->image_data_width * 3, nullptr, nullptr));
  return Picture(frame ? gdk_pixbuf_copy(frame.get()) : nullptr);
}

}  // namespace thumbnailer
