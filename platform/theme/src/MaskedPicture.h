#pragma once

#include "ImageMask.h"

namespace theme {

/// The picture of the file, upright, filling `size` (what does not fit is cut off around the
/// middle), masked. From malloc(); null, with a log line, when a file cannot be used.
uint32_t* maskedPicture(const char* picture, const char* mask, Size size, int maskX, int maskY);

}  // namespace theme
