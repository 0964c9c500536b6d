/// Texts that nobody can guess.
#pragma once

#include <string>

namespace service {

/// `bytes` random bytes from the kernel as hexadecimal digits; empty when it has none to give.
std::string randomHex(std::size_t bytes);

/// What is kept of a key, so that a stolen database opens nothing.
std::string fingerprint(const std::string& key);

}  // namespace service
