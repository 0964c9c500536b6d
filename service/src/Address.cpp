#include "Address.h"

#include <algorithm>
#include <cctype>
#include <charconv>

namespace service {
namespace {

bool allDigits(const char* begin, const char* end) {
  return std::all_of(begin, end, [](unsigned char c) { return isdigit(c) != 0; });
}

}  // namespace

std::vector<std::string> addressWords(SoupServerMessage* message) {
  const std::string path = g_uri_get_path(soup_server_message_get_uri(message));
  std::vector<std::string> words;
  std::size_t start = 1;
  while (start <= path.size()) {
    const std::size_t end = std::min(path.find('/', start), path.size());
    words.push_back(path.substr(start, end - start));
    start = end + 1;
  }
  return words;
}

std::optional<std::int64_t> plainNumber(const std::string& text) {
  const char* end = text.data() + text.size();
  if (text.empty() || !allDigits(text.data(), end) || (text.size() > 1 && text[0] == '0')) {
    return std::nullopt;
  }
  std::int64_t number = 0;
  const auto result = std::from_chars(text.data(), end, number);
  if (result.ec != std::errc()) return std::nullopt;
  return number;
}

bool isMsisdn(const std::string& text) {
  return text.size() >= 6 && text.size() <= 16 && text[0] == '+' &&
         allDigits(text.data() + 1, text.data() + text.size());
}

std::int64_t nowMs() {
  return g_get_real_time() / 1000;
}

}  // namespace service
