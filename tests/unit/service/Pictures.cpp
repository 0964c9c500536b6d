#include "Pictures.h"

#include <gdk-pixbuf/gdk-pixbuf.h>

#include <memory>

namespace {

struct Unref {
  void operator()(void* object) const { g_object_unref(object); }
};
using Picture = std::unique_ptr<GdkPixbuf, Unref>;

std::string bigEndian(unsigned number) {
  return {static_cast<char>(number >> 24), static_cast<char>(number >> 16),
          static_cast<char>(number >> 8), static_cast<char>(number)};
}

unsigned crc(const std::string& bytes) {
  unsigned sum = ~0U;
  for (const unsigned char byte : bytes) {
    sum ^= byte;
    for (int i = 0; i < 8; i++) sum = (sum >> 1) ^ (sum & 1 ? 0xedb88320U : 0);
  }
  return ~sum;
}

std::string chunk(const std::string& kind, const std::string& data) {
  return bigEndian(static_cast<unsigned>(data.size())) + kind + data + bigEndian(crc(kind + data));
}

const guint8* pixelAt(GdkPixbuf* picture, double x, double y) {
  const auto channels = static_cast<size_t>(gdk_pixbuf_get_n_channels(picture));
  const auto rowstride = static_cast<size_t>(gdk_pixbuf_get_rowstride(picture));
  const auto column = static_cast<size_t>(x * gdk_pixbuf_get_width(picture));
  const auto row = static_cast<size_t>(y * gdk_pixbuf_get_height(picture));
  return gdk_pixbuf_read_pixels(picture) + row * rowstride + column * channels;
}

bool isRed(GdkPixbuf* picture, double x, double y) {
  const guint8* pixel = pixelAt(picture, x, y);
  return pixel[0] > 150 && pixel[2] < 100;
}

bool isWhite(GdkPixbuf* picture, double x, double y) {
  const guint8* pixel = pixelAt(picture, x, y);
  return pixel[0] > 250 && pixel[1] > 250 && pixel[2] > 250;
}

std::string encoded(GdkPixbuf* picture, const char* format) {
  gchar* bytes = nullptr;
  gsize size = 0;
  gdk_pixbuf_save_to_buffer(picture, &bytes, &size, format, nullptr, nullptr);
  std::string text(bytes, size);
  g_free(bytes);
  return text;
}

}  // namespace

std::string encodedPicture(int width, int height, const char* format) {
  const Picture picture(gdk_pixbuf_new(GDK_COLORSPACE_RGB, FALSE, 8, width, height));
  gdk_pixbuf_fill(picture.get(), 0x0000ffff);
  const Picture quarter(
      gdk_pixbuf_new_subpixbuf(picture.get(), 0, 0, (width + 1) / 2, (height + 1) / 2));
  gdk_pixbuf_fill(quarter.get(), 0xff0000ff);
  return encoded(picture.get(), format);
}

std::string clearPicture(int width, int height) {
  const Picture picture(gdk_pixbuf_new(GDK_COLORSPACE_RGB, TRUE, 8, width, height));
  gdk_pixbuf_fill(picture.get(), 0);
  return encoded(picture.get(), "png");
}

std::string turnedJpeg(int width, int height) {
  static const char orientation[] =
      "\xff\xe1\x00\x22"
      "Exif\0\0"
      "MM\0\x2a\0\0\0\x08"
      "\0\x01"
      "\x01\x12\0\x03\0\0\0\x01\0\x06\0\0"
      "\0\0\0\0";
  const std::string jpeg = encodedPicture(width, height, "jpeg");
  return jpeg.substr(0, 2) + std::string(orientation, sizeof orientation - 1) + jpeg.substr(2);
}

std::string pngClaiming(unsigned width, unsigned height) {
  const std::string header =
      bigEndian(width) + bigEndian(height) + std::string("\x08\x02\0\0\0", 5);
  const std::string empty("\x78\x9c\x03\0\0\0\0\x01", 8);
  return "\x89PNG\r\n\x1a\n" + chunk("IHDR", header) + chunk("IDAT", empty) + chunk("IEND", "");
}

Decoded decode(const std::string& bytes) {
  Decoded decoded;
  GInputStream* stream =
      g_memory_input_stream_new_from_data(bytes.data(), static_cast<gssize>(bytes.size()), nullptr);
  const Picture picture(gdk_pixbuf_new_from_stream(stream, nullptr, nullptr));
  g_object_unref(stream);
  if (!picture) return decoded;
  decoded.width = gdk_pixbuf_get_width(picture.get());
  decoded.height = gdk_pixbuf_get_height(picture.get());
  decoded.isRedUpperLeft = isRed(picture.get(), 0.2, 0.2);
  decoded.isRedUpperRight = isRed(picture.get(), 0.8, 0.2);
  decoded.isWhiteUpperLeft = isWhite(picture.get(), 0.2, 0.2);
  return decoded;
}
