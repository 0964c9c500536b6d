#include "companion/Text.h"

#include <Elementary.h>
#include <appfw/AppId.h>
#include <common/Owned.h>
#include <libintl.h>

#include <cstdarg>
#include <cstdlib>

namespace companion {
namespace {

// The viewer counts like this too: one file has one size on all pages.
constexpr unsigned kKilobyte = 1024;
constexpr unsigned kMegabyte = 1024 * kKilobyte;

}  // namespace

const char* text(const char* id) {
  return dgettext(appfw::applicationId().c_str(), id);
}

std::string format(const char* id, ...) {
  va_list arguments;
  va_start(arguments, id);
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wformat-nonliteral"
  const common::OwnedText line(g_strdup_vprintf(text(id), arguments));
#pragma GCC diagnostic pop
  va_end(arguments);
  return line ? line.get() : "";
}

std::string filesText(int count) {
  return count == 1 ? text("1 file") : format("%d files", count);
}

std::string sizeText(unsigned long long bytes) {
  const bool isBig = bytes >= kMegabyte;
  const double size = static_cast<double>(bytes) / (isBig ? kMegabyte : kKilobyte);
  const common::OwnedText line(bytes < kKilobyte
                                   ? g_strdup_printf("%llu B", bytes)
                                   : g_strdup_printf("%.1f %s", size, isBig ? "MB" : "KB"));
  return line.get();
}

std::string escape(const std::string& plain) {
  const common::OwnedPlainText markup(
      evas_textblock_text_utf8_to_markup(nullptr, singleLine(plain).c_str()));
  return markup ? markup.get() : "";
}

std::string singleLine(const std::string& plain) {
  const common::OwnedText valid(g_utf8_make_valid(plain.data(), static_cast<gssize>(plain.size())));
  std::string line = valid.get();
  for (char& c : line) {
    if (static_cast<unsigned char>(c) < ' ') c = ' ';
  }
  return line;
}

}  // namespace companion
