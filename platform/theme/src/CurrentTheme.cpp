#include "CurrentTheme.h"

#include <vconf.h>

#include <cstdlib>
#include <cstring>

namespace {

constexpr const char* kThemeKey = "db/setting/theme";

}  // namespace

CurrentTheme& CurrentTheme::get() {
  static CurrentTheme current;
  return current;
}

ThemeStyle CurrentTheme::style() const {
  if (!changeable) return ThemeStyle::Light;
  char* choice = vconf_get_str(kThemeKey);
  const bool dark = choice && strcmp(choice, "dark") == 0;
  free(choice);
  return dark ? ThemeStyle::Dark : ThemeStyle::Light;
}
