#include "LogLine.h"

#include <glib.h>

#include <algorithm>
#include <climits>

namespace dlog {
namespace {

constexpr std::string_view kCut = "\033[0;m...";
constexpr size_t kTagLimit = 64;
constexpr char kFirstPrintable = ' ', kLastPrintable = '~';

/// How many characters there are that need no closer look: all of most texts.
size_t plainLength(std::string_view text) {
  const auto* end = std::find_if(text.begin(), text.end(),
                                 [](char c) { return c < kFirstPrintable || c > kLastPrintable; });
  return static_cast<size_t>(end - text.begin());
}

/// The length of the colour sequence that `text` starts with, or 0.
size_t colourLength(std::string_view text) {
  if (text.substr(0, 2) != "\033[") return 0;
  const size_t end = text.find_first_not_of("0123456789;", 2);
  return end != std::string_view::npos && text[end] == 'm' ? end + 1 : 0;
}

/// Two line separators and the C1 range break lines in some readers too.
bool breaksLine(gunichar c) {
  return g_unichar_iscntrl(c) || c == 0x2028 || c == 0x2029;
}

std::string escaped(std::string_view bytes) {
  if (bytes == "\n") return "\\n";
  if (bytes == "\r") return "\\r";
  if (bytes == "\t") return "\\t";
  std::string text;
  for (const unsigned char byte : bytes) {
    char hex[5];
    g_snprintf(hex, sizeof hex, "\\x%02x", byte);
    text += hex;
  }
  return text;
}

/// Takes the next character, colour sequence or stray byte off `text`.
std::string nextPiece(std::string_view& text) {
  size_t length = colourLength(text);
  bool plain = length > 0;
  if (!plain) {
    const gunichar c = g_utf8_get_char_validated(text.data(), static_cast<gssize>(text.size()));
    const bool valid = c != static_cast<gunichar>(-1) && c != static_cast<gunichar>(-2);
    length = valid ? g_unichar_to_utf8(c, nullptr) : 1;
    plain = valid && !breaksLine(c);
  }
  const std::string_view piece = text.substr(0, length);
  text.remove_prefix(length);
  return plain ? std::string(piece) : escaped(piece);
}

}  // namespace

std::string oneLine(std::string_view text, size_t limit) {
  std::string line;
  while (!text.empty()) {
    const size_t room = limit - std::min(limit, line.size() + kCut.size());
    const size_t plain = std::min(plainLength(text), room);
    line += text.substr(0, plain);
    text.remove_prefix(plain);
    if (plain > 0) continue;
    const std::string piece = nextPiece(text);
    if (line.size() + piece.size() + kCut.size() > limit) return line.append(kCut);
    line += piece;
  }
  return line;
}

std::string logLine(char priority, std::string_view tag, int pid, std::string_view message) {
  char process[16];
  g_snprintf(process, sizeof process, "(%5d): ", pid);
  std::string line{priority, '/'};
  line += oneLine(tag, kTagLimit);
  line += process;
  // Writes of up to PIPE_BUF bytes are never mixed with another process's.
  line += oneLine(message, PIPE_BUF - line.size() - 1);
  line += '\n';
  return line;
}

}  // namespace dlog
