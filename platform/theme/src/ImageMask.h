/// Cutting a picture out by a mask: arithmetic on pixels, nothing else.
#pragma once

#include <cstddef>
#include <cstdint>

namespace theme {

struct Size {
  int width;
  int height;
};

/// Eight bits a channel, rows `stride` bytes apart, three channels or four with opacity last.
struct Pixels {
  const uint8_t* data;
  Size size;
  size_t stride;
  int channels;

  const uint8_t* at(int x, int y) const {
    return data + static_cast<size_t>(y) * stride + static_cast<size_t>(x) * channels;
  }
  uint8_t opacity(int x, int y) const { return channels == 4 ? at(x, y)[3] : 255; }
};

/// Writes premultiplied ARGB, as many pixels as the picture has: its own opacity times that of the
/// mask, whose upper left corner lies at (maskX, maskY). Nothing is seen beside the mask.
void maskPixels(const Pixels& picture, const Pixels& mask, int maskX, int maskY, uint32_t* result);

}  // namespace theme
