#include "PickerRequest.h"

#include <companion/Launch.h>

#include <charconv>

namespace picker {
namespace {

constexpr std::size_t kDefaultMaxContacts = 10;

template <typename Number>
Number numberFrom(const std::string& text, Number otherwise) {
  Number number{};
  const char* end = text.data() + text.size();
  const auto parsed = std::from_chars(text.data(), end, number);
  return parsed.ec == std::errc() && parsed.ptr == end && number > 0 ? number : otherwise;
}

}  // namespace

PickerRequest readRequest(app_control_h request) {
  PickerRequest result;
  result.shareId = numberFrom<std::int64_t>(companion::extraOf(request, "zq_reshare"), 0);
  result.maxContacts =
      numberFrom<std::size_t>(companion::extraOf(request, "ct_max"), kDefaultMaxContacts);
  result.isSingle = companion::extraOf(request, "ct_operation") == APP_CONTROL_OPERATION_SHARE;
  return result;
}

}  // namespace picker
