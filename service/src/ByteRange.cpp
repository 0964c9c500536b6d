#include "ByteRange.h"

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <cstdlib>
#include <cstring>

namespace service {
namespace {

constexpr ByteRange kUnsatisfiable{ByteRange::Kind::Unsatisfiable, 0, 0};

// Moves past the digits; false when there are none or too many.
bool readNumber(const char*& text, std::int64_t& number) {
  if (!isdigit(static_cast<unsigned char>(*text))) return false;
  char* end = nullptr;
  errno = 0;
  number = strtoll(text, &end, 10);
  text = end;
  return errno == 0;
}

}  // namespace

ByteRange parseByteRange(const char* header, std::int64_t size) {
  static const char unit[] = "bytes=";
  if (!header || strncmp(header, unit, sizeof unit - 1) != 0) return {};
  const char* text = header + sizeof unit - 1;
  std::int64_t first = 0;
  std::int64_t last = size - 1;
  if (*text == '-') {
    std::int64_t suffix = 0;
    if (!readNumber(++text, suffix) || *text) return {};
    if (suffix == 0 || size == 0) return kUnsatisfiable;
    first = std::max<std::int64_t>(size - suffix, 0);
  } else {
    if (!readNumber(text, first) || *text++ != '-') return {};
    if (*text && (!readNumber(text, last) || *text || last < first)) return {};
    if (first >= size) return kUnsatisfiable;
    last = std::min(last, size - 1);
  }
  return {ByteRange::Kind::Part, first, last - first + 1};
}

}  // namespace service
