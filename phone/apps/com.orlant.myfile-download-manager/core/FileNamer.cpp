#include "FileNamer.h"

#include <common/Owned.h>

namespace downloads {
namespace {

constexpr std::size_t kMaxBytes = 255;
constexpr std::size_t kMaxExtensionBytes = 32;
constexpr const char* kNameless = "file";

// Characters that draw nothing but change how the others are shown: with them "exe.jpg" can be the
// picture of a name that ends in ".exe".
bool isInvisible(gunichar c) {
  const GUnicodeType type = g_unichar_type(c);
  return type == G_UNICODE_CONTROL || type == G_UNICODE_FORMAT ||
         type == G_UNICODE_LINE_SEPARATOR || type == G_UNICODE_PARAGRAPH_SEPARATOR;
}

// Joins emoji and letters of several scripts: harmless, and needed to read the name.
bool isJoiner(gunichar c) {
  return c == 0x200C || c == 0x200D;
}

std::string visibleCharacters(const std::string& name) {
  const common::OwnedText valid(g_utf8_make_valid(name.data(), static_cast<gssize>(name.size())));
  std::string result;
  for (const char* at = valid.get(); *at; at = g_utf8_next_char(at)) {
    const gunichar c = g_utf8_get_char(at);
    if (c == '/' || c == '\\') {
      result += '_';
    } else if (!isInvisible(c) || isJoiner(c)) {
      result.append(at, static_cast<std::size_t>(g_utf8_next_char(at) - at));
    }
  }
  return result;
}

std::string trimmed(const std::string& name) {
  const std::size_t first = name.find_first_not_of(' ');
  if (first == std::string::npos) return {};
  return name.substr(first, name.find_last_not_of(' ') - first + 1);
}

std::size_t extensionStart(const std::string& name) {
  const std::size_t dot = name.rfind('.');
  const bool hasExtension = dot != std::string::npos && dot > 0 &&
                            name.size() - dot <= kMaxExtensionBytes && dot + 1 < name.size();
  return hasExtension ? dot : name.size();
}

// Names that mean a device on the computers that the phone's storage may be plugged into.
bool isReserved(const std::string& name) {
  const common::OwnedText upper(g_ascii_strup(name.substr(0, name.find('.')).c_str(), -1));
  const std::string stem = upper.get();
  for (const char* word : {"CON", "PRN", "AUX", "NUL"}) {
    if (stem == word) return true;
  }
  const bool isPort = stem.compare(0, 3, "COM") == 0 || stem.compare(0, 3, "LPT") == 0;
  return isPort && stem.size() == 4 && stem[3] >= '1' && stem[3] <= '9';
}

// At most `bytes`, without cutting a character in two.
std::string cut(const std::string& text, std::size_t bytes) {
  if (text.size() <= bytes) return text;
  while (bytes > 0 && (static_cast<unsigned char>(text[bytes]) & 0xC0) == 0x80) bytes--;
  return text.substr(0, bytes);
}

std::string withStem(const std::string& name, const std::string& suffix) {
  const std::size_t dot = extensionStart(name);
  const std::string ending = suffix + name.substr(dot);
  return cut(name.substr(0, dot), kMaxBytes - ending.size()) + ending;
}

}  // namespace

std::string safeName(const std::string& name) {
  std::string safe = trimmed(visibleCharacters(name));
  // Also covers "." and "..": a hidden file would be lost to the user.
  if (!safe.empty() && safe[0] == '.') safe[0] = '_';
  if (safe.empty()) safe = kNameless;
  if (isReserved(safe)) safe.insert(0, 1, '_');
  return trimmed(withStem(safe, {}));
}

std::string numberedName(const std::string& safeName, unsigned int n) {
  return n == 0 ? safeName : withStem(safeName, " (" + std::to_string(n) + ")");
}

}  // namespace downloads
