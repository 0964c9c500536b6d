#pragma once

#include <map>
#include <memory>
#include <string>

/// Straight (not premultiplied), 0 to 255.
struct ThemeColor {
  int r = 0;
  int g = 0;
  int b = 0;
  int a = 0;
};

struct ThemeFont {
  std::string name;  ///< family, and ":style=" when it is not the regular one
  int size = 0;      ///< pixels at the design width
};

enum class ThemeStyle { Light, Dark };

/// Colours by code, for light and for dark.
class ColorTable {
 public:
  /// Null when the file is missing, too large or not such a table; the reason is logged. An entry
  /// that cannot be understood is skipped.
  static std::unique_ptr<ColorTable> read(const char* path);

  /// Null when the code is unknown.
  const ThemeColor* find(const std::string& code, ThemeStyle style) const;

 private:
  std::map<std::string, ThemeColor> _colors[2];
};

class FontTable {
 public:
  static std::unique_ptr<FontTable> read(const char* path);
  const ThemeFont* find(const std::string& code) const;

 private:
  std::map<std::string, ThemeFont> _fonts;
};

/// Hue 0-360, saturation, value and alpha 0-100; what lies outside is brought to the edge.
ThemeColor colorFromHsv(double hue, double saturation, double value, double alpha);
