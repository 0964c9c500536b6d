#pragma once

#include <stdint.h>

#include <vector>

/// Pixels in rows from the top, straight alpha, bytes red, green, blue, alpha.
struct Pixels {
  int width = 0;
  int height = 0;
  std::vector<uint8_t> rgba;
};

/// What of the image is seen through the mask's alpha laid at (x, y), premultiplied 32-bit ARGB.
/// Outside of the mask nothing is seen. The result has the image's size.
std::vector<uint32_t> maskPixels(const Pixels& image, const Pixels& mask, int x, int y);

/// The same for files: the image fills w x h, the mask keeps its own size. A malloc block, null
/// when a file cannot be read or is unreasonably large.
uint32_t* maskImage(const char* image, const char* mask, int w, int h, int x, int y);
