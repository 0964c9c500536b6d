#include "ThemeTables.h"

#include <dlog.h>
#include <libxml/parser.h>
#include <libxml/tree.h>
#include <sys/stat.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <cstring>

namespace {

constexpr const char* kTag = "THEME";
constexpr off_t kLargestTable = 1 << 20;
constexpr int kLargestFont = 400;

struct FreeDocument {
  void operator()(xmlDoc* document) const { xmlFreeDoc(document); }
};
using Document = std::unique_ptr<xmlDoc, FreeDocument>;

Document readDocument(const char* path, const char* rootName) {
  struct stat info = {};
  if (!path || stat(path, &info) != 0 || !S_ISREG(info.st_mode) || info.st_size > kLargestTable) {
    dlog_print(DLOG_ERROR, kTag, "no table at %s", path ? path : "(null)");
    return nullptr;
  }
  // Neither the network nor other files are read, and entities stay unexpanded.
  constexpr int kOptions = XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING;
  Document document(xmlReadFile(path, nullptr, kOptions));
  const xmlNode* root = document ? xmlDocGetRootElement(document.get()) : nullptr;
  if (!root || strcmp(reinterpret_cast<const char*>(root->name), rootName) != 0) {
    dlog_print(DLOG_ERROR, kTag, "%s is not a table of %s", path, rootName);
    return nullptr;
  }
  return document;
}

bool isElement(const xmlNode* node, const char* name) {
  return node->type == XML_ELEMENT_NODE &&
         strcmp(reinterpret_cast<const char*>(node->name), name) == 0;
}

/// Calls `visit` for each child element of that name.
template <typename Visit>
void forEach(const xmlNode* parent, const char* name, Visit visit) {
  for (xmlNode* child = parent->children; child; child = child->next) {
    if (isElement(child, name)) visit(child);
  }
}

std::string attribute(xmlNode* node, const char* name) {
  xmlChar* value = xmlGetProp(node, reinterpret_cast<const xmlChar*>(name));
  std::string text = value ? reinterpret_cast<const char*>(value) : "";
  xmlFree(value);
  return text;
}

/// False when the attribute is not a finite number.
bool number(xmlNode* node, const char* name, double* value) {
  const std::string text = attribute(node, name);
  char* end = nullptr;
  *value = strtod(text.c_str(), &end);
  return !text.empty() && !*end && std::isfinite(*value);
}

bool readColor(xmlNode* node, ThemeColor* color) {
  double hue = 0;
  double saturation = 0;
  double value = 0;
  double alpha = 0;
  if (!number(node, "hue", &hue) || !number(node, "saturation", &saturation) ||
      !number(node, "value", &value) || !number(node, "alpha", &alpha)) {
    return false;
  }
  *color = colorFromHsv(hue, saturation, value, alpha);
  return true;
}

bool readFont(xmlNode* node, ThemeFont* font) {
  double size = 0;
  const std::string typeface = attribute(node, "typeface");
  if (typeface.empty() || !number(node, "size", &size) || size < 1 || size > kLargestFont) {
    return false;
  }
  font->name = typeface;
  if (attribute(node, "style") == "B") font->name += ":style=Bold";
  font->size = static_cast<int>(size);
  return true;
}

int channel(double share) {
  return static_cast<int>(std::lround(share * 255));
}

}  // namespace

ThemeColor colorFromHsv(double hue, double saturation, double value, double alpha) {
  const double h = std::clamp(hue, 0.0, 360.0) / 60;
  const double s = std::clamp(saturation, 0.0, 100.0) / 100;
  const double v = std::clamp(value, 0.0, 100.0) / 100;
  const auto at = [&](double offset) {
    const double k = std::fmod(offset + h, 6);
    return channel(v - v * s * std::max(0.0, std::min({k, 4 - k, 1.0})));
  };
  return {at(5), at(3), at(1), channel(std::clamp(alpha, 0.0, 100.0) / 100)};
}

std::unique_ptr<ColorTable> ColorTable::read(const char* path) {
  const Document document = readDocument(path, "ChangeableColorTables");
  if (!document) return nullptr;
  auto table = std::make_unique<ColorTable>();
  forEach(xmlDocGetRootElement(document.get()), "ChangeableColorTable", [&](xmlNode* colors) {
    forEach(colors, "Theme", [&](xmlNode* theme) {
      auto& target = table->_colors[attribute(theme, "style") == "Dark"];
      forEach(theme, "ChangeableColorInfo", [&](xmlNode* entry) {
        ThemeColor color;
        if (readColor(entry, &color)) target[attribute(entry, "id")] = color;
      });
    });
  });
  return table;
}

const ThemeColor* ColorTable::find(const std::string& code, ThemeStyle style) const {
  const auto& colors = _colors[style == ThemeStyle::Dark];
  const auto found = colors.find(code);
  return found == colors.end() ? nullptr : &found->second;
}

std::unique_ptr<FontTable> FontTable::read(const char* path) {
  const Document document = readDocument(path, "FontInfoTable");
  if (!document) return nullptr;
  auto table = std::make_unique<FontTable>();
  forEach(xmlDocGetRootElement(document.get()), "FontInfo", [&](xmlNode* entry) {
    ThemeFont font;
    if (readFont(entry, &font)) table->_fonts[attribute(entry, "id")] = font;
  });
  return table;
}

const ThemeFont* FontTable::find(const std::string& code) const {
  const auto found = _fonts.find(code);
  return found == _fonts.end() ? nullptr : &found->second;
}
