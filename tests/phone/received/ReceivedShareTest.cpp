// A received share, from the upload to the page.

#include <gtest/gtest.h>

#include "Phone.h"

using phone::Phone;
using phone::Share;
using phone::thePhone;
using phone::Tree;
using phone::waitFor;
using phone::Words;

namespace {

constexpr const char* kSender = "+821011112222";

Words files(int count) {
  Words names;
  for (int i = 1; i <= count; i++) {
    names.push_back(thePhone().makeFile("File " + std::to_string(i) + ".txt", 100UL * i));
  }
  return names;
}

class ReceivedShare : public ::testing::Test {
 protected:
  void TearDown() override {
    thePhone().closeViewer();
    thePhone()({"rotate", "0"});
  }

  /// Whether the page comes to show that many cells.
  static bool shows(size_t cells) {
    return waitFor([=] { return thePhone().tree().items().size() == cells; });
  }
};

size_t columns(const Tree& tree) {
  const auto items = tree.items();
  if (items.empty()) return 0;
  // Upright, a row is a row of the screen; turned, it is a column.
  const bool turned = tree.widgets().front().area.width < tree.widgets().front().area.height &&
                      items.size() > 1 && items[0].area.x == items[1].area.x;
  size_t count = 0;
  for (const auto& item : items) {
    count += turned ? item.area.x == items[0].area.x : item.area.y == items[0].area.y;
  }
  return count;
}

}  // namespace

TEST_F(ReceivedShare, ShowsOneCellForEachFileAndAnEnabledDownloadButton) {
  Phone& phone = thePhone();
  const Share share = phone.share(files(9));
  phone.launchReceived(share.token);
  ASSERT_TRUE(shows(9)) << phone.tree();
  const Tree tree = phone.tree();
  for (int i = 1; i <= 9; i++) {
    EXPECT_TRUE(tree.named("File " + std::to_string(i) + ".txt")) << i << '\n' << tree;
  }
  EXPECT_TRUE(tree.enables("Download")) << tree;
  EXPECT_NE(tree.text().find(kSender), std::string::npos) << tree;
}

TEST_F(ReceivedShare, HasSevenColumnsWhenThePhoneLiesAndFourWhenItStands) {
  Phone& phone = thePhone();
  const Share share = phone.share(files(14));
  phone.launchReceived(share.token);
  ASSERT_TRUE(shows(14));
  EXPECT_EQ(columns(phone.tree()), 4u) << phone.tree();
  phone({"rotate", "90"});
  EXPECT_TRUE(waitFor([&] { return columns(phone.tree()) == 7; })) << phone.tree();
  phone({"rotate", "0"});
  EXPECT_TRUE(waitFor([&] { return columns(phone.tree()) == 4; })) << phone.tree();
}

TEST_F(ReceivedShare, ShowsTheSendersNameFromTheAddressBook) {
  Phone& phone = thePhone();
  phone({"contact", "add", "Anna Lindqvist", kSender});
  const Share share = phone.share(files(1));
  phone.launchReceived(share.token);
  EXPECT_TRUE(waitFor([&] {
    return phone.tree().text().find("Anna Lindqvist") != std::string::npos;
  })) << phone.tree();
  phone({"contact", "rename", "Anna Lindqvist", "Anna L."});
  EXPECT_TRUE(waitFor([&] { return phone.tree().text().find("Anna L.") != std::string::npos; }))
      << phone.tree();
  phone({"contact", "remove", "Anna L."});
}

TEST_F(ReceivedShare, ShowsTheExpiredPageWhenItsTimeIsOver) {
  Phone& phone = thePhone();
  const Share share = phone.share(files(3), {"--expires-in", "1"});
  EXPECT_TRUE(waitFor([&] {
    phone.launchReceived(share.token);
    const Tree tree = phone.tree();
    return !tree.widgets().empty() && tree.items().empty() && !tree.enables("Download") &&
           tree.text().find(kSender) != std::string::npos;
  })) << phone.tree();
}

TEST_F(ReceivedShare, IsReplacedByTheNextOne) {
  Phone& phone = thePhone();
  const Share first = phone.share(files(5));
  const Share second = phone.share({phone.makeFile("Other.txt")});
  phone.launchReceived(first.token);
  ASSERT_TRUE(shows(5));
  phone.launchReceived(second.token);
  ASSERT_TRUE(shows(1)) << phone.tree();
  EXPECT_TRUE(phone.tree().named("Other.txt"));
}

TEST_F(ReceivedShare, IsReadWithoutTheService) {
  Phone& phone = thePhone();
  const Share share = phone.share(files(4));
  phone({"service", "down"});
  phone.launchReceived(share.token);
  EXPECT_TRUE(shows(4)) << phone.tree();
  phone({"service", "ok"});
}

TEST_F(ReceivedShare, ShowsNamesWithMarkupAsTheyAre) {
  Phone& phone = thePhone();
  const Share share = phone.share({phone.makeFile("<b>R&D %s %n.txt")});
  phone.launchReceived(share.token);
  ASSERT_TRUE(shows(1));
  EXPECT_TRUE(phone.tree().named("<b>R&D %s %n.txt")) << phone.tree();
}

TEST_F(ReceivedShare, ClosesOnBack) {
  Phone& phone = thePhone();
  phone.launchReceived(phone.share(files(2)).token);
  ASSERT_TRUE(shows(2));
  phone({"key", "Escape"});
  EXPECT_TRUE(waitFor([&] { return phone({"tree"}).empty(); })) << phone.tree();
}
