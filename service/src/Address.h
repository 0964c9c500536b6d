/// The parts of a request's address.
#pragma once

#include <libsoup/soup.h>

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace service {

/// "/share/abc/file/0" as its words; an encoded address is not decoded, since none of ours needs
/// it.
std::vector<std::string> addressWords(SoupServerMessage* message);

/// A number as it stands in addresses and queries: digits alone, without leading zeros.
std::optional<std::int64_t> plainNumber(const std::string& text);

/// A phone number in international form: a plus and 5 to 15 digits.
bool isMsisdn(const std::string& text);

std::int64_t nowMs();

}  // namespace service
