/// How often the read side was asked, for tests and load measurements.
#pragma once

#include <array>
#include <cstdint>

namespace service {

struct Stats {
  std::int64_t manifests = 0;
  std::array<std::int64_t, 4> blobs{};  ///< by BlobKind
  std::int64_t fileBytes = 0;           ///< body bytes of files that left
};

}  // namespace service
