#include "DownloadRequest.h"

#include <companion/Launch.h>

#include <charconv>

namespace downloads {
namespace {

std::uint64_t sizeFrom(const std::string& text) {
  std::uint64_t size = 0;
  const char* end = text.data() + text.size();
  const auto parsed = std::from_chars(text.data(), end, size);
  return parsed.ec == std::errc() && parsed.ptr == end ? size : 0;
}

}  // namespace

std::vector<Download> readRequest(app_control_h request) {
  const auto urls = companion::extrasOf(request, "url");
  const auto names = companion::extrasOf(request, "name");
  const auto sizes = companion::extrasOf(request, "size");
  if (urls.size() != names.size() || urls.size() != sizes.size()) {
    g_warning("downloads: a request of %zu addresses, %zu names and %zu sizes", urls.size(),
              names.size(), sizes.size());
    return {};
  }
  std::vector<Download> wanted(urls.size());
  for (std::size_t i = 0; i < urls.size(); i++) {
    wanted[i].url = urls[i];
    wanted[i].name = names[i];
    wanted[i].size = sizeFrom(sizes[i]);
    wanted[i].token = companion::extraOf(request, "token");
    wanted[i].sender = companion::extraOf(request, "sender");
    wanted[i].wifiOnly = companion::extraOf(request, "wifi_check") == "1";
  }
  return wanted;
}

}  // namespace downloads
