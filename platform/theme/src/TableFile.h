/// An XML table of the application, read with care: no document type, limited size and depth.
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace theme {

class TableFile {
 public:
  struct Element {
    std::string name;
    std::map<std::string, std::string> attributes;
    std::vector<Element> children;
  };

  /// Null, with a log line, when the file is no table with this root element.
  static std::unique_ptr<TableFile> read(const char* path, const char* root);

  const Element& root() const { return _root; }

  static void forEach(const Element& parent, const char* name,
                      const std::function<void(const Element&)>& visit);
  /// Empty without the attribute.
  static std::string text(const Element& element, const char* attribute);
  /// `missing` when there is no number between the limits.
  static double number(const Element& element, const char* attribute, double low, double high,
                       double missing);

 private:
  explicit TableFile(Element root) : _root(std::move(root)) {}

  const Element _root;
};

}  // namespace theme
