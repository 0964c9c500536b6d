// Without a finger: Tab, the arrows, Enter and Escape reach and work every control of every page,
// and it is to be seen where the keyboard is.

#include "Companions.h"
#include "Picture.h"

using phone::Colour;
using phone::thePhone;
using phone::Tree;
using phone::waitFor;
using phone::Widget;

namespace {

constexpr const char* kOwnNumber = "+821012345678";
constexpr const char* kFriend = "+821011112222";
constexpr Colour kAccent{10, 106, 138};
/// More than any page has.
constexpr int kMostSteps = 20;

struct Shares {
  std::string received, expired;
  long sent = 0;
};

/// The same for all tests: none of them takes anything away.
const Shares& shares() {
  static const Shares all = [] {
    const phone::Words files{thePhone().makeFile("a.txt"),
                             thePhone().makeFile("b.pdf", 7000000),  // asks for Wi-Fi
                             thePhone().makeFile("c.zip")};
    Shares made;
    made.received = thePhone().share(files).token;
    made.expired = thePhone().share(files, {"--expires-in", "1"}).token;
    made.sent = thePhone().shareTo(kFriend, kOwnNumber, files).request;
    return made;
  }();
  return all;
}

bool isContainer(const Widget& widget) {
  return widget.role == "list" || widget.role == "tree table";
}

/// The name of what the keys go to. A list remembers its row while the keys go elsewhere.
std::string focused() {
  bool isListFocused = true;
  const Tree tree = thePhone().tree();
  for (const Widget& widget : tree.widgets()) {
    if (isContainer(widget)) isListFocused = widget.is("focused");
    const bool isItem = widget.role == "list item";
    if (!isItem && !isContainer(widget) && widget.role != "check box") isListFocused = true;
    if (widget.is("focused") && !widget.name.empty() && (!isItem || isListFocused)) {
      return widget.name;
    }
  }
  return "";
}

void press(const std::string& key) {
  thePhone()({"key", key});
}

/// Goes there by that key, step by step.
testing::AssertionResult reach(const std::string& name, const std::string& key = "Tab") {
  std::string way;
  for (int step = 0; step < kMostSteps; step++) {
    const std::string now = focused();
    if (now.rfind(name, 0) == 0) return testing::AssertionSuccess();
    way += now + " > ";
    press(key);
  }
  return testing::AssertionFailure() << name << " is not on the way " << way;
}

/// Goes to the full view's pages.
bool isPagerReached() {
  return waitFor([] {
    const Tree tree = thePhone().tree();
    for (const Widget& widget : tree.widgets()) {
      if (widget.role == "tree table" && widget.is("focused")) return true;
    }
    press("Tab");
    return false;
  });
}

/// The full view names its page after the file on screen.
testing::AssertionResult isPage(const std::string& name) {
  const bool came = waitFor([&] {
    const auto pages = thePhone().tree().withRole("page tab");
    return !pages.empty() && pages.back().name.rfind(name + ", ", 0) == 0;
  });
  if (came) return testing::AssertionSuccess();
  return testing::AssertionFailure() << name << " is not the page of\n" << thePhone().tree();
}

bool isAccent(int x, int y) {
  return waitFor([&] { return phone::colourAt(thePhone(), x, y).isAbout(kAccent); },
                 std::chrono::seconds(5));
}

phone::Area areaOf(const std::string& name) {
  const Tree tree = thePhone().tree();
  const Widget* widget = tree.named(name);
  return widget ? widget->area : phone::Area{};
}

class Keyboard : public testing::Test {
 protected:
  void TearDown() override { thePhone().closeViewer(); }

  static void openReceived() {
    thePhone().launchReceived(shares().received);
    ASSERT_TRUE(comes("a.txt"));
  }

  static void openSelection() {
    openReceived();
    ASSERT_TRUE(reach("Download"));
    press("Return");
    ASSERT_TRUE(comes("Select all"));
  }

  static void openSent() {
    thePhone()({"launch", "sent", "--request", std::to_string(shares().sent)});
    ASSERT_TRUE(comes("Recall"));
  }
};

}  // namespace

TEST_F(Keyboard, ReachesEverythingOnTheReceivedPage) {
  openReceived();
  EXPECT_TRUE(reach("Download"));
  EXPECT_TRUE(reach("Back"));
  EXPECT_TRUE(reach("Download", "shift+Tab"));
  press("Tab");
  EXPECT_TRUE(reach("a.txt", "Left"));
  EXPECT_TRUE(reach("c.zip", "Right"));
  EXPECT_TRUE(reach("b.pdf", "Left"));
  press("Return");
  EXPECT_TRUE(comes("b.pdf"));
  EXPECT_TRUE(goes("Files from"));
  press("Escape");
  EXPECT_TRUE(comes("Files from"));
}

TEST_F(Keyboard, SelectsAndDownloads) {
  openSelection();
  if (HasFatalFailure()) return;
  EXPECT_TRUE(reach("Select all"));
  press("Return");
  EXPECT_TRUE(comes("3 selected"));
  press("Return");
  EXPECT_TRUE(comes("Select items"));
  EXPECT_TRUE(reach("a.txt"));
  EXPECT_TRUE(reach("b.pdf", "Right"));
  press("Return");
  EXPECT_TRUE(comes("1 selected"));
  EXPECT_TRUE(comes("b.pdf, 6.7MB, PDF, not downloaded, selected"));
  press("Return");
  EXPECT_TRUE(comes("Select items"));
  press("space");
  EXPECT_TRUE(comes("1 selected"));
  EXPECT_TRUE(reach("Done"));
  press("Return");
  EXPECT_TRUE(comes("Download via Wi-Fi only"));
  EXPECT_TRUE(reach("Cancel"));
  EXPECT_TRUE(reach("Download via Wi-Fi only"));
  press("space");
  EXPECT_TRUE(waitFor([] {
    const Tree tree = thePhone().tree();
    const Widget* check = tree.named("Download via Wi-Fi only");
    return check && check->is("checked");
  }));
  EXPECT_TRUE(reach("Download"));
  press("Escape");
  EXPECT_TRUE(goes("Download via Wi-Fi only"));
  press("Escape");
  EXPECT_TRUE(comes("Files from"));
}

TEST_F(Keyboard, TurnsThePagesOfTheFullView) {
  openReceived();
  ASSERT_TRUE(tap("b.pdf"));
  ASSERT_TRUE(goes("Files from"));
  EXPECT_TRUE(reach("Back"));
  ASSERT_TRUE(isPagerReached());
  press("Right");
  EXPECT_TRUE(isPage("c.zip"));
  press("Right");  // there is none further
  press("Left");
  EXPECT_TRUE(isPage("b.pdf"));
  press("Left");
  EXPECT_TRUE(isPage("a.txt"));
  EXPECT_TRUE(reach("Download"));
  press("Left");  // a button turns no page
  EXPECT_TRUE(isPage("a.txt"));
}

TEST_F(Keyboard, ReachesEverythingOnTheSentPage) {
  openSent();
  if (HasFatalFailure()) return;
  EXPECT_TRUE(reach("a.txt"));
  EXPECT_TRUE(reach("c.zip", "Right"));
  EXPECT_TRUE(reach("Back"));
  EXPECT_TRUE(reach("Reshare"));
  EXPECT_TRUE(reach("Recall"));
  press("Return");
  EXPECT_TRUE(comes("OK"));
  EXPECT_TRUE(reach("OK"));
  EXPECT_TRUE(reach("Cancel"));
  press("Return");
  EXPECT_TRUE(goes("OK"));
}

TEST_F(Keyboard, LeavesTheExpiredPage) {
  thePhone().launchReceived(shares().expired);
  ASSERT_TRUE(comes("This share has expired"));
  EXPECT_TRUE(reach("Back"));
  press("Return");
  EXPECT_TRUE(goes("This share has expired"));
}

TEST_F(Keyboard, IsSeenWhereItIs) {
  openReceived();
  const phone::Area cell = areaOf("a.txt,");
  const phone::Area button = areaOf("Download");
  EXPECT_FALSE(phone::colourAt(thePhone(), cell.x + 4, cell.y + cell.height / 2).isAbout(kAccent));
  EXPECT_TRUE(reach("Download"));
  EXPECT_TRUE(isAccent(button.x + button.width / 2, button.y - 6));
  press("Tab");
  EXPECT_TRUE(reach("a.txt", "Left"));
  EXPECT_TRUE(isAccent(cell.x + 4, cell.y + cell.height / 2));
  EXPECT_FALSE(
      phone::colourAt(thePhone(), button.x + button.width / 2, button.y - 6).isAbout(kAccent));
}
