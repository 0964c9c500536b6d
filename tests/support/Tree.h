/// What `phone tree` prints, as objects.
#pragma once

#include <iosfwd>
#include <string>
#include <vector>

namespace phone {

struct Area {
  int x = 0, y = 0, width = 0, height = 0;

  int right() const { return x + width; }
  int bottom() const { return y + height; }
};

struct Widget {
  std::string role, name;
  std::vector<std::string> states;
  Area area;  ///< on the screen
  int depth = 0;

  bool is(const std::string& state) const;
};

class Tree {
 public:
  explicit Tree(std::string text);

  const std::vector<Widget>& widgets() const { return _widgets; }
  const std::string& text() const { return _text; }

  /// The first widget of that name, or else whose name begins with it; null when there is none.
  const Widget* named(const std::string& name) const;
  bool shows(const std::string& name) const;
  /// A widget of that name is there, and enabled.
  bool enables(const std::string& name) const;
  std::vector<Widget> withRole(const std::string& role) const;
  /// The items of lists and grids that have names.
  std::vector<Widget> items() const;

 private:
  std::string _text;
  std::vector<Widget> _widgets;
};

std::ostream& operator<<(std::ostream& out, const Tree& tree);

}  // namespace phone
