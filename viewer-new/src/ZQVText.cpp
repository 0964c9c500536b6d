#include "ZQVText.h"

#include <Evas.h>
#include <libintl.h>
#include <printf.h>

#include <array>
#include <cstdarg>
#include <cstdlib>
#include <cstring>

#include "ZQVOwned.h"

namespace {

constexpr const char* kPlatformDomain = "sys_string";

/// Does the format take exactly these arguments?
bool takesArguments(const char* format, const char* arguments) {
  std::array<int, 8> types{};
  const size_t count = parse_printf_format(format, types.size(), types.data());
  if (count != strlen(arguments) || count > types.size()) return false;
  for (size_t i = 0; i < count; ++i) {
    if (types[i] != (arguments[i] == 's' ? PA_STRING : PA_INT)) return false;
  }
  // %n stores through its argument; no message may.
  return !strstr(format, "%n");
}

}  // namespace

const char* zqvText(const char* id) {
  if (!id || !*id) return "";
  const char* text = dgettext(ZQV_TEXT_DOMAIN, id);
  if (strcmp(text, id) != 0) return text;
  return dgettext(kPlatformDomain, id);
}

std::string zqvFormat(const char* id, const char* arguments, ...) {
  const char* format = zqvText(id);
  if (!takesArguments(format, arguments)) return id ? id : "";
  va_list values;
  va_start(values, arguments);
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wformat-nonliteral"
  ZQVOwnedText text(g_strdup_vprintf(format, values));
#pragma GCC diagnostic pop
  va_end(values);
  return text.get();
}

std::string zqvEscape(const char* text) {
  if (!text) return {};
  ZQVPlatformText markup(evas_textblock_text_utf8_to_markup(nullptr, text));
  return markup ? markup.get() : "";
}
