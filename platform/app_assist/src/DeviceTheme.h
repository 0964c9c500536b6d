/// The looks of the phone: the theme over the toolkit's own, its palettes, the size of text.
#pragma once

#include <string>

namespace app_assist {

class DeviceTheme {
 public:
  /// "/opt/usr/share/theme/device.edj", or what the environment variable APP_ASSIST_THEME says.
  static std::string path();

  /// Before the first widget is made. False, with a log line, when the theme cannot be read.
  static bool install();
  /// "light" or "dark", as the settings have it; on every open window at once.
  static void applyPalette();
  /// As the accessibility settings have it.
  static void applyTextSize();
  /// Pixels of the theme are those of a screen 720 wide; this fits them to the screen.
  static void applyScale();
};

}  // namespace app_assist
