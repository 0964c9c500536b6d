#include "TableFile.h"

#include <common/Owned.h>
#include <dlog.h>
#include <libxml/parser.h>

namespace theme {
namespace {

constexpr size_t kMaxBytes = size_t{1024} * 1024;

const xmlChar* xmlText(const char* text) {
  return reinterpret_cast<const xmlChar*>(text);
}

xmlDoc* parse(const char* path) {
  char* text = nullptr;
  size_t length = 0;
  if (!g_file_get_contents(path, &text, &length, nullptr)) return nullptr;
  const common::OwnedText owned(text);
  if (length > kMaxBytes) return nullptr;
  return xmlReadMemory(text, static_cast<int>(length), nullptr, nullptr,
                       XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING);
}

}  // namespace

std::unique_ptr<TableFile> TableFile::read(const char* path, const char* root) {
  common::Owned<xmlDoc, xmlFreeDoc> document(path ? parse(path) : nullptr);
  // A table needs no document type, and a document type can make a small file a large one.
  if (document && !document->intSubset) {
    xmlNode* element = xmlDocGetRootElement(document.get());
    if (element && xmlStrEqual(element->name, xmlText(root))) {
      return std::unique_ptr<TableFile>(new TableFile(document.release(), element));
    }
  }
  dlog_print(DLOG_ERROR, "THEME", "%s is not a %s", path ? path : "(null)", root);
  return nullptr;
}

TableFile::~TableFile() {
  xmlFreeDoc(_document);
}

void TableFile::forEach(const xmlNode* parent, const char* name,
                        const std::function<void(const xmlNode*)>& visit) {
  for (const xmlNode* node = parent->children; node; node = node->next) {
    if (node->type == XML_ELEMENT_NODE && xmlStrEqual(node->name, xmlText(name))) visit(node);
  }
}

std::string TableFile::text(const xmlNode* node, const char* attribute) {
  xmlChar* value = xmlGetNoNsProp(node, xmlText(attribute));
  std::string text = value ? reinterpret_cast<const char*>(value) : "";
  xmlFree(value);
  return text;
}

double TableFile::number(const xmlNode* node, const char* attribute, double low, double high,
                         double missing) {
  const std::string value = text(node, attribute);
  char* end = nullptr;
  const double number = g_ascii_strtod(value.c_str(), &end);
  const bool valid = !value.empty() && *end == '\0' && number >= low && number <= high;
  return valid ? number : missing;
}

}  // namespace theme
