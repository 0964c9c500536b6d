#include "ColourTable.h"

#include <dlog.h>

#include <algorithm>
#include <cmath>

#include "TableFile.h"

namespace theme {
namespace {

constexpr double kMissing = -1;

void readColour(const TableFile::Element& node, ColourTable::Colours& colours) {
  const std::string id = TableFile::text(node, "id");
  const double hue = TableFile::number(node, "hue", 0, 360, kMissing);
  const double saturation = TableFile::number(node, "saturation", 0, 100, kMissing);
  const double value = TableFile::number(node, "value", 0, 100, kMissing);
  const double alpha = TableFile::number(node, "alpha", 0, 100, kMissing);
  if (id.empty() || hue < 0 || saturation < 0 || value < 0 || alpha < 0) {
    dlog_print(DLOG_WARN, "THEME", "colour \"%s\" is left out: bad numbers", id.c_str());
    return;
  }
  colours[id] = fromHsv(hue, saturation, value, alpha);
}

}  // namespace

Colour fromHsv(double hue, double saturation, double value, double alpha) {
  const double chroma = value * saturation / 100;
  // How much of the chroma a channel has that lies `offset` degrees from red.
  const auto channel = [=](double offset) {
    const double k = std::fmod(offset + hue / 60, 6);
    const double part = value - chroma * std::max(0.0, std::min({k, 4 - k, 1.0}));
    return static_cast<int>(std::lround(part * 255 / 100));
  };
  return {channel(5), channel(3), channel(1), static_cast<int>(std::lround(alpha * 255 / 100))};
}

std::unique_ptr<ColourTable> ColourTable::read(const char* path) {
  const auto file = TableFile::read(path, "ChangeableColorTables");
  if (!file) return nullptr;
  auto table = std::make_unique<ColourTable>();
  TableFile::forEach(file->root(), "ChangeableColorTable", [&](const TableFile::Element& part) {
    TableFile::forEach(part, "Theme", [&](const TableFile::Element& theme) {
      Colours& colours = TableFile::text(theme, "style") == "Dark" ? table->_dark : table->_light;
      TableFile::forEach(theme, "ChangeableColorInfo",
                         [&](const TableFile::Element& node) { readColour(node, colours); });
    });
  });
  return table;
}

}  // namespace theme
