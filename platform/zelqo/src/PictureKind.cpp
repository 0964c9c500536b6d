#include "PictureKind.h"

#include <cstring>

namespace zelqo {
namespace {

bool startsWith(const char* head, std::size_t size, const char* magic, std::size_t length) {
  return size >= length && memcmp(head, magic, length) == 0;
}

}  // namespace

const char* pictureExtension(const char* head, std::size_t size) {
  if (startsWith(head, size, "\x89PNG\r\n\x1a\n", 8)) return ".png";
  if (startsWith(head, size, "\xff\xd8\xff", 3)) return ".jpg";
  if (startsWith(head, size, "GIF87a", 6) || startsWith(head, size, "GIF89a", 6)) return ".gif";
  const bool riff = startsWith(head, size, "RIFF", 4) && size >= kPictureMagicSize;
  return riff && memcmp(head + 8, "WEBP", 4) == 0 ? ".webp" : nullptr;
}

}  // namespace zelqo
