#include "ImageMask.h"

namespace theme {
namespace {

/// a * b / 255, rounded.
uint32_t scaled(uint32_t a, uint32_t b) {
  return (a * b + 127) / 255;
}

uint32_t maskOpacity(const Pixels& mask, int x, int y) {
  const bool inside = x >= 0 && y >= 0 && x < mask.size.width && y < mask.size.height;
  return inside ? mask.opacity(x, y) : 0;
}

}  // namespace

void maskPixels(const Pixels& picture, const Pixels& mask, int maskX, int maskY, uint32_t* result) {
  for (int y = 0; y < picture.size.height; y++) {
    for (int x = 0; x < picture.size.width; x++) {
      const uint8_t* pixel = picture.at(x, y);
      const uint32_t opacity =
          scaled(picture.opacity(x, y), maskOpacity(mask, x - maskX, y - maskY));
      *result++ = opacity << 24 | scaled(pixel[0], opacity) << 16 | scaled(pixel[1], opacity) << 8 |
                  scaled(pixel[2], opacity);
    }
  }
}

}  // namespace theme
