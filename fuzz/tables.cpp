// The tables of colours and fonts: any XML, any numbers in it.

#include "ColourTable.h"
#include "FontTable.h"
#include "Require.h"
#include "TemporaryFile.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static TemporaryFile file;
  file.write(data, size);
  if (const auto table = theme::ColourTable::read(file.path())) {
    for (const auto style : {theme::Style::Light, theme::Style::Dark}) {
      for (const auto& [id, colour] : table->colours(style)) {
        for (const int part : {colour.r, colour.g, colour.b, colour.a}) {
          require(part >= 0 && part <= 255);
        }
      }
    }
  }
  if (const auto table = theme::FontTable::read(file.path())) {
    for (const auto& [id, font] : table->fonts()) {
      require(font.size >= 1 && font.size <= 300);
      require(font.name.find_first_of(" <>&") == std::string::npos);
    }
  }
  return 0;
}
