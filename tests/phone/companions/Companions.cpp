#include "Companions.h"

#include <fstream>
#include <iterator>

using phone::thePhone;
using phone::Tree;
using phone::waitFor;
using phone::Widget;

namespace {

testing::AssertionResult result(bool came, const std::string& what) {
  if (came) return testing::AssertionSuccess();
  return testing::AssertionFailure() << what << " on\n" << thePhone().tree();
}

// A button or a row: the page may have a title of the same name.
const Widget* touchable(const Tree& tree, const std::string& name) {
  for (const Widget& widget : tree.widgets()) {
    const bool takesTaps = widget.role == "push button" || widget.role == "list item";
    if (takesTaps && widget.is("enabled") && widget.name.rfind(name, 0) == 0) return &widget;
  }
  return nullptr;
}

}  // namespace

void open(const char* application) {
  thePhone()({"launch", "raw", "default", "--app", application});
}

testing::AssertionResult comes(const std::string& name) {
  return result(waitFor([&] { return thePhone().tree().named(name) != nullptr; }),
                "no \"" + name + "\"");
}

testing::AssertionResult goes(const std::string& name) {
  return result(waitFor([&] { return thePhone().tree().named(name) == nullptr; }),
                "still \"" + name + "\"");
}

testing::AssertionResult tap(const std::string& name) {
  std::string centre;
  const bool came = waitFor([&] {
    const Tree tree = thePhone().tree();
    const auto* widget = touchable(tree, name);
    if (!widget) return false;
    centre = std::to_string(widget->area.x + widget->area.width / 2) + "," +
             std::to_string(widget->area.y + widget->area.height / 2);
    return true;
  });
  if (came) thePhone()({"tap", centre});
  return result(came, "no enabled \"" + name + "\"");
}

testing::AssertionResult says(const std::string& text) {
  const bool came =
      waitFor([&] { return thePhone()({"messages"}).find(text) != std::string::npos; });
  if (came) return testing::AssertionSuccess();
  return testing::AssertionFailure() << "never said: " << text << "\nbut\n"
                                     << thePhone()({"messages"});
}

std::string contentOf(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

std::string ofPhone(const std::string& path) {
  return thePhone().folder() + "/opt-usr" + path.substr(std::string("/opt/usr").size());
}
