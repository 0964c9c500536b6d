/// The look that the phone's user has chosen, which has no names of the platform's.
#pragma once

namespace settings {

/// Text: "light" or "dark".
constexpr const char* kThemeKey = "db/setting/theme";
/// Int: percent of the normal size of texts.
constexpr const char* kTextSizeKey = "db/setting/accessibility/font_size";

bool isDark();
/// 80 to 200.
int textSize();

}  // namespace settings
