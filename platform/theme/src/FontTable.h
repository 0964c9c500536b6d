/// The fonts of an application.
#pragma once

#include <map>
#include <memory>
#include <string>

namespace theme {

struct Font {
  /// As the canvas wants it: family, and the weight when it is not regular.
  std::string name;
  /// Pixels on a screen 720 wide.
  int size;
};

class FontTable {
 public:
  /// Null when the file is no font table. Entries without a sensible size are left out.
  static std::unique_ptr<FontTable> read(const char* path);

  const std::map<std::string, Font>& fonts() const { return _fonts; }

 private:
  std::map<std::string, Font> _fonts;
};

}  // namespace theme
