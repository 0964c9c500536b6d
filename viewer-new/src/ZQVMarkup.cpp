#include "ZQVMarkup.h"

#include <glib.h>

#include <cstring>

#include "ZQVOwned.h"
#include "ZQVText.h"

namespace {

/// Would the character break the line or do something else than being seen?
bool isControl(gunichar character) {
  const GUnicodeType type = g_unichar_type(character);
  return type == G_UNICODE_CONTROL || type == G_UNICODE_LINE_SEPARATOR ||
         type == G_UNICODE_PARAGRAPH_SEPARATOR;
}

}  // namespace

std::string zqvEscapeWithin(const char* text, size_t limit) {
  if (!text) return {};
  ZQVOwnedText valid(g_utf8_make_valid(text, -1));
  std::string markup;
  for (const char* at = valid.get(); *at;) {
    const char* next = g_utf8_next_char(at);
    const std::string character(at, static_cast<size_t>(next - at));
    const bool control = isControl(g_utf8_get_char(at));
    const std::string escaped = control ? " " : zqvEscape(character.c_str());
    at = next;
    if (markup.size() + escaped.size() > limit) break;
    markup += escaped;
  }
  return markup;
}

std::string zqvFormatName(const char* id, const char* name, size_t limit) {
  const size_t frame = zqvFormat(id, "s", "").size();
  const std::string shown = zqvEscapeWithin(name, limit > frame ? limit - frame : 0);
  return zqvFormat(id, "s", shown.c_str());
}

std::string zqvFromReadingSide(const char* markup, bool isRightToLeft) {
  constexpr const char* kLeft = "<align=left>";
  std::string text = markup;
  const size_t at = isRightToLeft ? text.find(kLeft) : std::string::npos;
  if (at != std::string::npos) text.replace(at, strlen(kLeft), "<align=right>");
  return text;
}
