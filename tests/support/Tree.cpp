#include "Tree.h"

#include <algorithm>
#include <ostream>
#include <sstream>

namespace phone {
namespace {

std::string unescaped(const std::string& text) {
  std::string result;
  for (size_t i = 0; i < text.size(); i++) {
    if (text[i] != '\\' || i + 1 == text.size()) {
      result += text[i];
      continue;
    }
    const char c = text[++i];
    result += c == 'n' ? '\n' : c == 't' ? '\t' : c;
  }
  return result;
}

/// Where the quoted name ends: quotes inside are escaped.
size_t endOfName(const std::string& line, size_t begin) {
  size_t i = begin;
  while (i < line.size() && line[i] != '"') i += line[i] == '\\' ? 2 : 1;
  return i;
}

bool read(const std::string& line, Widget& widget) {
  const size_t role = line.find_first_not_of(' ');
  const size_t quote = line.find('"');
  if (role == std::string::npos || quote == std::string::npos || quote < role + 1) return false;
  const size_t end = endOfName(line, quote + 1);
  const size_t open = line.find('[', end), close = line.find(']', end);
  if (open == std::string::npos || close == std::string::npos) return false;
  widget.depth = static_cast<int>(role / 2);
  widget.role = line.substr(role, quote - role - 1);
  widget.name = unescaped(line.substr(quote + 1, end - quote - 1));
  std::istringstream states(line.substr(open + 1, close - open - 1));
  for (std::string state; std::getline(states, state, ',');) widget.states.push_back(state);
  char comma = 0, x = 0;
  std::istringstream area(line.substr(close + 1));
  area >> widget.area.x >> comma >> widget.area.y >> widget.area.width >> x >> widget.area.height;
  return !area.fail() && comma == ',' && x == 'x';
}

}  // namespace

bool Widget::is(const std::string& state) const {
  return std::find(states.begin(), states.end(), state) != states.end();
}

Tree::Tree(std::string text) : _text(std::move(text)) {
  std::istringstream lines(_text);
  for (std::string line; std::getline(lines, line);) {
    Widget widget;
    if (read(line, widget)) _widgets.push_back(std::move(widget));
  }
}

const Widget* Tree::named(const std::string& name) const {
  const auto found = [&](auto fits) {
    return std::find_if(_widgets.begin(), _widgets.end(), fits);
  };
  auto widget = found([&](const Widget& one) { return one.name == name; });
  if (widget == _widgets.end()) {
    widget = found([&](const Widget& one) { return one.name.compare(0, name.size(), name) == 0; });
  }
  return widget == _widgets.end() ? nullptr : &*widget;
}

bool Tree::shows(const std::string& name) const {
  const Widget* widget = named(name);
  return widget && widget->is("showing");
}

bool Tree::enables(const std::string& name) const {
  const Widget* widget = named(name);
  return widget && widget->is("enabled");
}

std::vector<Widget> Tree::withRole(const std::string& role) const {
  std::vector<Widget> result;
  for (const auto& widget : _widgets) {
    if (widget.role == role) result.push_back(widget);
  }
  return result;
}

std::vector<Widget> Tree::items() const {
  std::vector<Widget> result;
  for (const auto& widget : withRole("list item")) {
    if (!widget.name.empty()) result.push_back(widget);
  }
  return result;
}

std::ostream& operator<<(std::ostream& out, const Tree& tree) {
  return out << tree.text();
}

}  // namespace phone
