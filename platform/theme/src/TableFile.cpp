#include "TableFile.h"

#include <common/Owned.h>
#include <dlog.h>
#include <expat.h>

#include <optional>
#include <utility>

namespace theme {
namespace {

using Element = TableFile::Element;

constexpr size_t kMaxBytes = size_t{1024} * 1024;
constexpr size_t kMaxDepth = 16;

using Parser = common::Owned<XML_ParserStruct, XML_ParserFree>;

/// Builds the elements from what the parser meets on its way.
class Reader {
 public:
  std::optional<Element> read(const std::string& text) {
    _parser.reset(XML_ParserCreate(nullptr));
    if (!_parser) return std::nullopt;
    XML_SetUserData(_parser.get(), this);
    XML_SetElementHandler(_parser.get(), startCb, endCb);
    XML_SetStartDoctypeDeclHandler(_parser.get(), doctypeCb);
    const auto status =
        XML_Parse(_parser.get(), text.data(), static_cast<int>(text.size()), XML_TRUE);
    if (status != XML_STATUS_OK || _document.children.empty()) return std::nullopt;
    return std::move(_document.children.front());
  }

 private:
  static void startCb(void* data, const char* name, const char** attributes) {
    auto* self = static_cast<Reader*>(data);
    if (self->_open.size() > kMaxDepth) {
      XML_StopParser(self->_parser.get(), XML_FALSE);
      return;
    }
    Element& element = self->_open.back()->children.emplace_back();
    element.name = name;
    for (; *attributes; attributes += 2) element.attributes[attributes[0]] = attributes[1];
    self->_open.push_back(&element);
  }

  static void endCb(void* data, const char*) { static_cast<Reader*>(data)->_open.pop_back(); }

  /// A table needs no document type, and a document type can make a small file a large one.
  static void doctypeCb(void* data, const char*, const char*, const char*, int) {
    XML_StopParser(static_cast<Reader*>(data)->_parser.get(), XML_FALSE);
  }

  Parser _parser;
  Element _document;
  /// An element's children grow only while it is the last one here, so the addresses hold.
  std::vector<Element*> _open{&_document};
};

std::optional<Element> parse(const char* path) {
  char* text = nullptr;
  size_t length = 0;
  if (!g_file_get_contents(path, &text, &length, nullptr)) return std::nullopt;
  const common::OwnedText owned(text);
  return length > kMaxBytes ? std::nullopt : Reader().read({text, length});
}

}  // namespace

std::unique_ptr<TableFile> TableFile::read(const char* path, const char* root) {
  std::optional<Element> element = path ? parse(path) : std::nullopt;
  if (element && element->name == root) {
    return std::unique_ptr<TableFile>(new TableFile(std::move(*element)));
  }
  dlog_print(DLOG_ERROR, "THEME", "%s is not a %s", path ? path : "(null)", root);
  return nullptr;
}

void TableFile::forEach(const Element& parent, const char* name,
                        const std::function<void(const Element&)>& visit) {
  for (const Element& child : parent.children) {
    if (child.name == name) visit(child);
  }
}

std::string TableFile::text(const Element& element, const char* attribute) {
  const auto found = element.attributes.find(attribute);
  return found == element.attributes.end() ? std::string() : found->second;
}

double TableFile::number(const Element& element, const char* attribute, double low, double high,
                         double missing) {
  const std::string value = text(element, attribute);
  char* end = nullptr;
  const double number = g_ascii_strtod(value.c_str(), &end);
  const bool valid = !value.empty() && *end == '\0' && number >= low && number <= high;
  return valid ? number : missing;
}

}  // namespace theme
