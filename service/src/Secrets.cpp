#include "Secrets.h"

#include <sys/random.h>

#include <vector>

#include "Owned.h"

namespace service {

std::string randomHex(std::size_t bytes) {
  std::vector<unsigned char> noise(bytes);
  if (getrandom(noise.data(), bytes, 0) != static_cast<ssize_t>(bytes)) return {};
  static const char digits[] = "0123456789abcdef";
  std::string text;
  text.reserve(bytes * 2);
  for (const unsigned char byte : noise) {
    text += digits[byte >> 4];
    text += digits[byte & 15];
  }
  return text;
}

std::string fingerprint(const std::string& key) {
  const Text sum(g_compute_checksum_for_string(G_CHECKSUM_SHA256, key.c_str(),
                                               static_cast<gssize>(key.size())));
  return sum.get();
}

}  // namespace service
