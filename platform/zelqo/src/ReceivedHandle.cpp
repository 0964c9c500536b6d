#include "ReceivedHandle.h"

#include <algorithm>
#include <utility>

namespace zelqo {
namespace {

// Ends are compared in whole seconds, and the second of the end still counts as before it.
constexpr std::int64_t kPastMs = 1000;

bool isComplete(const std::string& address) {
  return address.rfind("http://", 0) == 0 || address.rfind("https://", 0) == 0;
}

}  // namespace

void ReceivedHandle::set(ReceivedShare share, char* sender, const std::string& serviceUrl) {
  _token = share.token;
  _sender = sender;
  _base = share.base;
  if (_base.empty() && !serviceUrl.empty()) _base = serviceUrl + "/share/" + share.token;
  _endMs = share.expiresMs;
  if (share.recalledMs) _endMs = std::min(_endMs, *share.recalledMs - kPastMs);
  _files = std::move(share.files);
  _fileCount = _files.size();
}

void ReceivedHandle::dropFiles() {
  _files = {};
}

std::optional<std::string> ReceivedHandle::address(
    const std::optional<std::string>& address) const {
  if (!address || address->empty() || isComplete(*address)) return address;
  if (_base.empty()) return std::nullopt;
  return _base + "/" + *address;
}

}  // namespace zelqo
