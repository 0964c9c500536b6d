/// Which pictures the library takes from the network.
#pragma once

#include <cstddef>

namespace zelqo {

/// How many first bytes of a file decide.
constexpr std::size_t kPictureMagicSize = 12;

/// File name extension with its dot for PNG, JPEG, WebP and GIF; null for everything else.
const char* pictureExtension(const char* head, std::size_t size);

}  // namespace zelqo
