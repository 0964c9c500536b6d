#include "FontTable.h"

#include <dlog.h>

#include "TableFile.h"

namespace theme {
namespace {

constexpr double kMaxSize = 300;

/// By the letter in the table; regular is the family alone.
const char* weightOf(const std::string& style) {
  if (style == "B") return ":weight=bold";
  if (style == "M") return ":weight=medium";
  if (style == "L") return ":weight=light";
  return "";
}

/// The name becomes part of mark-up, where a blank would end it.
bool isPlain(const std::string& typeface) {
  return !typeface.empty() && typeface.find_first_of(" <>&='\"") == std::string::npos;
}

}  // namespace

std::unique_ptr<FontTable> FontTable::read(const char* path) {
  const auto file = TableFile::read(path, "FontInfoTable");
  if (!file) return nullptr;
  auto table = std::make_unique<FontTable>();
  TableFile::forEach(file->root(), "FontInfo", [&](const TableFile::Element& node) {
    const std::string id = TableFile::text(node, "id");
    const std::string typeface = TableFile::text(node, "typeface");
    const int size = static_cast<int>(TableFile::number(node, "size", 1, kMaxSize, 0));
    if (id.empty() || !isPlain(typeface) || size == 0) {
      dlog_print(DLOG_WARN, "THEME", "font \"%s\" is left out: bad values", id.c_str());
      return;
    }
    table->_fonts[id] = {typeface + weightOf(TableFile::text(node, "style")), size};
  });
  return table;
}

}  // namespace theme
