/// The Range header of one request.
#pragma once

#include <cstdint>

namespace service {

struct ByteRange {
  enum class Kind { Whole, Part, Unsatisfiable };
  Kind kind = Kind::Whole;
  std::int64_t first = 0;
  std::int64_t length = 0;
};

/// Several ranges, other units and what cannot be read ask for the whole.
ByteRange parseByteRange(const char* header, std::int64_t size);

}  // namespace service
