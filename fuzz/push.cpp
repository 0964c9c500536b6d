// What the sharing service answers: pushes, the shares in them, and what becomes of their
// addresses.

#include "ReceivedHandle.h"
#include "Require.h"

#include <zelqo/Push.h>

#include <string_view>

namespace {

bool isAddress(const std::optional<std::string>& text) {
  return !text || text->empty() || text->rfind("http://", 0) == 0 ||
         text->rfind("https://", 0) == 0;
}

void look(const zelqo::ReceivedShare& share) {
  require(!share.sender.empty() && share.sender.size() <= 32);
  require(share.token.find('/') == std::string::npos);
  zelqo::ReceivedHandle handle;
  handle.set(share, nullptr, "http://127.0.0.1:8080");
  for (const auto& file : share.files) {
    require(!file.size || *file.size >= 0);
    for (const auto& address : {file.url, file.thumb, file.mid, file.big}) {
      require(!share.base.empty() || isAddress(handle.address(address)));
    }
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const auto push = zelqo::readPush(std::string_view(reinterpret_cast<const char*>(data), size));
  if (!push) return 0;
  require(push->cursor >= 0);
  for (const auto& event : push->events) {
    if (event.kind == zelqo::PushEvent::Kind::Received) look(event.share);
  }
  return 0;
}
