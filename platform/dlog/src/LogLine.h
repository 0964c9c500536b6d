/// One line of the log.
#pragma once

#include <string>
#include <string_view>

namespace dlog {

/// The text as one line: control characters and bytes that are not UTF-8 become escapes; colour
/// sequences stay. Longer texts are cut at `limit` bytes, with the colour switched off.
std::string oneLine(std::string_view text, size_t limit);

/// "E/TAG( pid): message" and a line break.
std::string logLine(char priority, std::string_view tag, int pid, std::string_view message);

}  // namespace dlog
