#include "FullPage.h"

#include <filesystem>

#include "User.h"

namespace fs = std::filesystem;
using phone::Area;
using phone::thePhone;
using phone::Tree;
using phone::waitFor;
using phone::Widget;
using phone::Words;

namespace {

constexpr const char* kOwnNumber = "+821012345678";
constexpr const char* kFriend = "+821011112222";
constexpr const char* kNoApplication = "No app found for this action.";

bool isSame(const Area& a, const Area& b) {
  return a.x == b.x && a.y == b.y && a.width == b.width && a.height == b.height;
}

// The place of the page that fills the pager, from 1; 0 while none does.
size_t pageNumberOn(const Tree& tree) {
  const Widget* pager = nullptr;
  for (const Widget& widget : tree.widgets()) {
    if (widget.role == "tree table" && widget.is("showing")) pager = &widget;
  }
  const std::vector<Widget> pages = tree.items();
  for (size_t i = 0; pager && i < pages.size(); i++) {
    if (pages[i].is("showing") && isSame(pages[i].area, pager->area)) return i + 1;
  }
  return 0;
}

testing::AssertionResult buttonIs(const std::string& name, const std::string& state) {
  const bool came = waitFor([&] {
    const Tree tree = thePhone().tree();
    for (const Widget& widget : tree.widgets()) {
      if (widget.role == "push button" && widget.name == name && widget.is(state)) return true;
    }
    return false;
  });
  return seen(thePhone(), came, "no " + state + " \"" + name + "\"");
}

void tapCell(const std::string& name) {
  ASSERT_TRUE(comes(name));
  thePhone()({"tap", name});
  ASSERT_TRUE(pageIs(name));
  thePhone()({"painted"});  // a page that is still coming in takes no input
}

}  // namespace

void FullPage::TearDown() {
  thePhone()({"service", "ok"});
  thePhone()({"network", "wifi"});
  thePhone()({"rotate", "0"});
  thePhone()({"language", "en_US.UTF-8"});
  thePhone().closeViewer();
  closePrograms();
  for (const auto& file : fs::directory_iterator(ofPhone("/opt/usr/media/Downloads"))) {
    fs::remove_all(file);
  }
}

Words numberedFiles(int count) {
  Words names;
  for (int i = 1; i <= count; i++) {
    names.push_back(thePhone().makeFile("File " + std::to_string(i) + ".txt", 10));
  }
  return names;
}

void openReceived(const Words& files, const std::string& cell) {
  thePhone().launchReceived(thePhone().share(files).token);
  tapCell(cell);
}

void openSent(const Words& files, const std::string& cell) {
  const phone::Share share = thePhone().shareTo(kFriend, kOwnNumber, files);
  thePhone()({"launch", "sent", "--request", std::to_string(share.request)});
  tapCell(cell);
}

std::string pageOn(const Tree& tree) {
  const size_t number = pageNumberOn(tree);
  return number ? tree.items()[number - 1].name : "";
}

Area pageArea(const Tree& tree) {
  const size_t number = pageNumberOn(tree);
  return number ? tree.items()[number - 1].area : Area{};
}

testing::AssertionResult pageNumberIs(size_t number) {
  return seen(thePhone(), waitFor([&] { return pageNumberOn(thePhone().tree()) == number; }),
              "not page " + std::to_string(number));
}

testing::AssertionResult pageIs(const std::string& name) {
  return seen(thePhone(),
              waitFor([&] { return pageOn(thePhone().tree()).rfind(name + ", ", 0) == 0; }),
              "\"" + name + "\" is not the page");
}

// Far enough to turn the page however slow the machine is.
void swipeForth() {
  thePhone()({"swipe", "690,640", "70,640", "250"});
}

void swipeBack() {
  thePhone()({"swipe", "30,640", "650,640", "250"});
}

testing::AssertionResult buttonIsEnabled(const std::string& name) {
  return buttonIs(name, "enabled");
}

testing::AssertionResult buttonIsDisabled(const std::string& name) {
  return buttonIs(name, "disabled");
}

testing::AssertionResult download() {
  const testing::AssertionResult tapped = tap("Download");
  return tapped ? buttonIsEnabled("Open") : tapped;
}

bool closePrograms() {
  return thePhone().end({"gpicview", "l3afpad", "mpv", "zathura"});
}

size_t countOf(const std::string& text, const std::string& part) {
  size_t count = 0;
  for (size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) count++;
  return count;
}

testing::AssertionResult openIsRefused() {
  const auto refusals = [] { return countOf(thePhone()({"messages"}), kNoApplication); };
  const size_t before = refusals();
  const testing::AssertionResult tapped = tap("Open");
  if (!tapped) return tapped;
  return seen(thePhone(), waitFor([&] { return refusals() == before + 1; }), "no message");
}
