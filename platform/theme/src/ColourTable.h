/// The changeable colours of an application: one set for each theme of the phone.
#pragma once

#include <map>
#include <memory>
#include <string>

namespace theme {

/// 0 to 255, not premultiplied.
struct Colour {
  int r, g, b, a;
  bool operator==(const Colour& other) const {
    return r == other.r && g == other.g && b == other.b && a == other.a;
  }
};

/// Hue in degrees, the others in percent.
Colour fromHsv(double hue, double saturation, double value, double alpha);

enum class Style { Light, Dark };

class ColourTable {
 public:
  using Colours = std::map<std::string, Colour>;

  /// Null when the file is no colour table. Entries with missing or senseless numbers are left out.
  static std::unique_ptr<ColourTable> read(const char* path);

  const Colours& colours(Style style) const { return style == Style::Dark ? _dark : _light; }

 private:
  Colours _light;
  Colours _dark;
};

}  // namespace theme
