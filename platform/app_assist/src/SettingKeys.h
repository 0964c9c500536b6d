/// Settings of the phone that the framework follows and that have no name of the platform's.
#pragma once

namespace app_assist {

/// Text: "light" or "dark".
constexpr const char* kThemeKey = "db/setting/theme";
/// Int: percent of the normal size, 80 to 200.
constexpr const char* kTextSizeKey = "db/setting/accessibility/font_size";

}  // namespace app_assist
