// Pictures that cannot be shown: the icon of their kind stands, and the pages go on.

#include <fstream>

#include "FullPage.h"

using phone::kRed;
using phone::thePhone;
using phone::Tree;
using phone::waitFor;
using phone::Words;

namespace {

using BadPictures = FullPage;

std::string written(const std::string& name, const std::string& content) {
  std::string path = thePhone().makeFile(name, 0);
  std::ofstream(path, std::ios::binary) << content;
  return path;
}

Words badPictures() {
  const std::string whole = contentOf(phone::makePicture(thePhone(), "Whole.png", kRed, 600, 600));
  return {written("Cut.png", whole.substr(0, whole.size() / 3)),
          written("Huge.png", phone::pngHeader(30000, 30000)),
          written("Words.jpg", "These are words, no picture.\n"),
          written("Empty.png", ""),
          written("Half a header.png", whole.substr(0, 20)),
          written("Other kind.jpg", whole)};
}

std::string viewer() {
  return thePhone().processesOf({"zelqo-viewer"});
}

bool showsSomething() {
  return waitFor([] {
    const Tree tree = thePhone().tree();
    for (const auto& widget : tree.widgets()) {
      if (widget.role == "icon" && widget.is("showing") && widget.area.width > 0) return true;
    }
    return false;
  });
}

void expectAllPages() {
  const std::string before = viewer();
  // A share leaves out what is empty.
  for (const char* name :
       {"Cut.png", "Huge.png", "Words.jpg", "Half a header.png", "Other kind.jpg"}) {
    ASSERT_TRUE(pageIs(name));
    EXPECT_TRUE(showsSomething()) << name << '\n' << thePhone().tree();
    swipeForth();
  }
  EXPECT_EQ(viewer(), before) << "the viewer was started anew";
}

}  // namespace

TEST_F(BadPictures, OfAReceivedShareLeaveTheirIcon) {
  openReceived(badPictures(), "Cut.png");
  expectAllPages();
}

TEST_F(BadPictures, OfASentShareLeaveTheirIcon) {
  openSent(badPictures(), "Cut.png");
  expectAllPages();
  // What is wrong is only the name: this picture is shown.
  EXPECT_TRUE(waitFor([] { return phone::colourAt(thePhone(), 360, 640).isAbout(kRed); }))
      << phone::colourAt(thePhone(), 360, 640);
}
