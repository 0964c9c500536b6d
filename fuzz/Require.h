#pragma once

#include <cstdlib>

/// What has to be true for every input.
inline void require(bool condition) {
  if (!condition) abort();
}
