#include "User.h"

namespace phone {
namespace {

// A page may have a title of the same name.
const Widget* touchable(const Tree& tree, const std::string& name) {
  for (const Widget& widget : tree.widgets()) {
    const bool takesTaps = widget.role == "push button" || widget.role == "list item";
    if (takesTaps && widget.is("enabled") && widget.name.rfind(name, 0) == 0) return &widget;
  }
  return nullptr;
}

}  // namespace

testing::AssertionResult seen(const Phone& phone, bool came, const std::string& wrong) {
  if (came) return testing::AssertionSuccess();
  return testing::AssertionFailure() << wrong << " on\n" << phone.tree();
}

testing::AssertionResult comes(const Phone& phone, const std::string& name) {
  return seen(phone, waitFor([&] { return phone.tree().named(name) != nullptr; }),
              "no \"" + name + "\"");
}

testing::AssertionResult goes(const Phone& phone, const std::string& name) {
  return seen(phone, waitFor([&] { return phone.tree().named(name) == nullptr; }),
              "still \"" + name + "\"");
}

testing::AssertionResult tap(const Phone& phone, const std::string& name) {
  std::string centre;
  const bool came = waitFor([&] {
    const Tree tree = phone.tree();
    const Widget* widget = touchable(tree, name);
    if (widget) centre = centreOf(*widget);
    return widget != nullptr;
  });
  if (came) phone({"tap", centre});
  return seen(phone, came, "no enabled \"" + name + "\"");
}

testing::AssertionResult says(const Phone& phone, const std::string& text) {
  if (waitFor([&] { return phone({"messages"}).find(text) != std::string::npos; })) {
    return testing::AssertionSuccess();
  }
  return testing::AssertionFailure() << "never said: " << text << "\nbut\n" << phone({"messages"});
}

std::string centreOf(const Widget& widget) {
  return std::to_string(widget.area.x + widget.area.width / 2) + "," +
         std::to_string(widget.area.y + widget.area.height / 2);
}

}  // namespace phone
