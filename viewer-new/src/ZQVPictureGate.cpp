#include "ZQVPictureGate.h"

#include <fcntl.h>
#include <stdint.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>

#include "ZQVLog.h"

namespace {

constexpr uint32_t kLongestSide = 8192;
constexpr uint64_t kMostPixels = 40000000;
constexpr uint64_t kMostLightPixels = 4000000;
constexpr uint64_t kMostQuickPixels = 150000;
constexpr uint64_t kMostReducedPixels = 200000000;
constexpr off_t kLargestThumbnail = 8 << 20;
/// A JPEG file may carry this many blocks (embedded profiles, notes) before its size.
constexpr int kMostJpegBlocks = 512;

struct PictureSize {
  uint32_t width = 0;
  uint32_t height = 0;
  bool reducible = false;  ///< the loader can decode it at a fraction of its size

  uint64_t pixels() const { return static_cast<uint64_t>(width) * height; }
};

/// A file that is closed with the end of its scope.
class OpenFile {
 public:
  /// Not blocking, so that a pipe under a picture's name holds nothing up.
  explicit OpenFile(const char* path) : _fd(open(path, O_RDONLY | O_CLOEXEC | O_NONBLOCK)) {}
  ~OpenFile() {
    if (_fd >= 0) close(_fd);
  }
  OpenFile(const OpenFile&) = delete;
  OpenFile& operator=(const OpenFile&) = delete;

  bool isOpen() const { return _fd >= 0; }
  bool stat(struct stat* info) const { return fstat(_fd, info) == 0; }
  /// False unless there is something to read; what the file lacks stays as it was.
  bool read(off_t offset, uint8_t* bytes, size_t count) const {
    return pread(_fd, bytes, count, offset) > 0;
  }

 private:
  int _fd;
};

uint32_t big16(const uint8_t* at) {
  return static_cast<uint32_t>(at[0]) << 8 | at[1];
}
uint32_t big32(const uint8_t* at) {
  return big16(at) << 16 | big16(at + 2);
}
uint32_t little16(const uint8_t* at) {
  return static_cast<uint32_t>(at[1]) << 8 | at[0];
}
uint32_t little24(const uint8_t* at) {
  return little16(at) | static_cast<uint32_t>(at[2]) << 16;
}
uint32_t little32(const uint8_t* at) {
  return little16(at) | little16(at + 2) << 16;
}

bool startsWith(const uint8_t* bytes, const char* magic, size_t count) {
  return memcmp(bytes, magic, count) == 0;
}

bool readPng(const uint8_t* head, PictureSize* size) {
  if (!startsWith(head, "\x89PNG\r\n\x1a\n", 8) || !startsWith(head + 12, "IHDR", 4)) return false;
  size->width = big32(head + 16);
  size->height = big32(head + 20);
  return true;
}

bool readGif(const uint8_t* head, PictureSize* size) {
  if (!startsWith(head, "GIF87a", 6) && !startsWith(head, "GIF89a", 6)) return false;
  size->width = little16(head + 6);
  size->height = little16(head + 8);
  return true;
}

bool readBmp(const uint8_t* head, PictureSize* size) {
  if (!startsWith(head, "BM", 2)) return false;
  const bool old = little32(head + 14) == 12;
  size->width = old ? little16(head + 18) : little32(head + 18);
  size->height = old ? little16(head + 20) : little32(head + 22);
  // A negative height means that the rows run from top to bottom.
  if (!old && size->height > INT32_MAX) size->height = -size->height;
  return true;
}

bool readWebp(const uint8_t* head, PictureSize* size) {
  if (!startsWith(head, "RIFF", 4) || !startsWith(head + 8, "WEBP", 4)) return false;
  if (startsWith(head + 12, "VP8X", 4)) {
    size->width = little24(head + 24) + 1;
    size->height = little24(head + 27) + 1;
  } else if (startsWith(head + 12, "VP8L", 4)) {
    const uint32_t bits = little32(head + 21);
    size->width = (bits & 0x3fff) + 1;
    size->height = (bits >> 14 & 0x3fff) + 1;
  } else if (startsWith(head + 12, "VP8 ", 4)) {
    size->width = little16(head + 26) & 0x3fff;
    size->height = little16(head + 28) & 0x3fff;
  }
  return true;
}

/// Does the block with this marker carry the picture's size?
bool isFrame(uint8_t marker) {
  return marker >= 0xc0 && marker <= 0xcf && marker != 0xc4 && marker != 0xc8 && marker != 0xcc;
}

bool readJpeg(const OpenFile& file, const uint8_t* head, PictureSize* size) {
  if (!startsWith(head, "\xff\xd8\xff", 3)) return false;
  off_t at = 2;
  uint8_t block[9] = {};
  for (int i = 0; i < kMostJpegBlocks && file.read(at, block, sizeof block); ++i) {
    if (block[0] != 0xff) break;
    if (block[1] == 0xff) {  // padding in front of a marker
      ++at;
    } else if (isFrame(block[1])) {
      size->height = big16(block + 5);
      size->width = big16(block + 7);
      size->reducible = true;
      break;
    } else {
      at += 2 + static_cast<off_t>(big16(block + 2));
    }
  }
  return true;
}

bool readSize(const OpenFile& file, PictureSize* size) {
  uint8_t head[32] = {};
  if (!file.read(0, head, sizeof head)) return false;
  return readPng(head, size) || readJpeg(file, head, size) || readGif(head, size) ||
         readWebp(head, size) || readBmp(head, size);
}

/// Why the picture must not be shown; null when it may.
const char* refusalOf(const OpenFile& file, ZQVPictureGate::Use use) {
  struct stat info = {};
  if (!file.stat(&info) || !S_ISREG(info.st_mode)) return "not a regular file";
  const bool thumbnail = use == ZQVPictureGate::Thumbnail;
  if (thumbnail && info.st_size > kLargestThumbnail) return "too many bytes";
  PictureSize size;
  if (!readSize(file, &size)) return "not a known kind of picture";
  if (size.width == 0 || size.height == 0) return "no size";
  const uint64_t pixels = size.pixels();
  if (!thumbnail && size.reducible) {
    return pixels > kMostReducedPixels ? "too many pixels" : nullptr;
  }
  if (size.width > kLongestSide || size.height > kLongestSide) return "too long a side";
  return pixels > kMostPixels ? "too many pixels" : nullptr;
}

}  // namespace

bool ZQVPictureGate::passes(const char* path, Use use) {
  if (!path || !*path) return false;
  const OpenFile file(*path == '/' ? path : "");
  if (*path == '/' && !file.isOpen()) return false;
  const char* reason = *path == '/' ? refusalOf(file, use) : "not an absolute path";
  if (reason) ZQV_ERROR("picture refused, %s: %s", reason, path);
  return reason == nullptr;
}

ZQVPictureGate::Decoding ZQVPictureGate::decodingOf(const char* path) {
  const OpenFile file(path);
  PictureSize size;
  if (!file.isOpen() || !readSize(file, &size)) return {};
  return {size.reducible, size.pixels() > kMostQuickPixels};
}

bool ZQVPictureGate::isLight(const char* path) {
  const OpenFile file(path);
  PictureSize size;
  if (!file.isOpen() || refusalOf(file, FullView) || !readSize(file, &size)) return false;
  return size.reducible || size.pixels() <= kMostLightPixels;
}
