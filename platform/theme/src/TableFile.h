/// An XML table of the application, read with care: no network, no document type, limited size.
#pragma once

#include <libxml/tree.h>

#include <functional>
#include <memory>
#include <string>

namespace theme {

class TableFile {
 public:
  /// Null, with a log line, when the file is no table with this root element.
  static std::unique_ptr<TableFile> read(const char* path, const char* root);
  ~TableFile();
  TableFile(const TableFile&) = delete;
  TableFile& operator=(const TableFile&) = delete;

  const xmlNode* root() const { return _root; }

  static void forEach(const xmlNode* parent, const char* name,
                      const std::function<void(const xmlNode*)>& visit);
  /// Empty without the attribute.
  static std::string text(const xmlNode* node, const char* attribute);
  /// `missing` when there is no number between the limits.
  static double number(const xmlNode* node, const char* attribute, double low, double high,
                       double missing);

 private:
  TableFile(xmlDoc* document, xmlNode* root) : _document(document), _root(root) {}

  xmlDoc* const _document;
  xmlNode* const _root;
};

}  // namespace theme
