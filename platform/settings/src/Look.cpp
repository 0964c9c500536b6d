#include "settings/Look.h"

#include <common/Owned.h>
#include <vconf.h>

#include <algorithm>
#include <cstring>

namespace settings {

bool isDark() {
  const common::OwnedPlainText name(vconf_get_str(kThemeKey));
  return name && strcmp(name.get(), "dark") == 0;
}

int textSize() {
  int percent = 100;
  vconf_get_int(kTextSizeKey, &percent);
  return std::clamp(percent, 80, 200);
}

}  // namespace settings
