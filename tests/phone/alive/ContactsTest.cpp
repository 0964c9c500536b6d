// The sender's name follows the address book while the page is open.

#include "AlivePage.h"

using phone::thePhone;

namespace {

constexpr const char* kSender = "+821011112222";

class Contacts : public AlivePage {
 protected:
  void SetUp() override {
    thePhone().launchReceived(thePhone().share({thePhone().makeFile("Note.txt")}).token);
    ASSERT_TRUE(comes(std::string("Files from ") + kSender));
    _viewer = viewerProcess();
  }
  void TearDown() override {
    EXPECT_EQ(viewerProcess(), _viewer) << "the viewer was started anew";
    AlivePage::TearDown();
    for (const char* name : {"Ida Berg", "Ida Holm"}) {
      thePhone().command({"contact", "remove", name});
    }
  }

 private:
  std::string _viewer;
};

}  // namespace

TEST_F(Contacts, ThatAreAddedRenamedAndRemovedChangeTheTitle) {
  thePhone()({"contact", "add", "Ida Berg", kSender});
  EXPECT_TRUE(comes("Files from Ida Berg"));
  thePhone()({"contact", "rename", "Ida Berg", "Ida Holm"});
  EXPECT_TRUE(comes("Files from Ida Holm"));
  thePhone()({"contact", "remove", "Ida Holm"});
  EXPECT_TRUE(comes(std::string("Files from ") + kSender));
}

TEST_F(Contacts, ThatChangeUnderTheFullPageChangeTheTitleBelow) {
  thePhone()({"tap", "Note.txt"});
  ASSERT_TRUE(goes("Files from"));
  thePhone()({"contact", "add", "Ida Berg", kSender});
  thePhone()({"key", "Escape"});
  EXPECT_TRUE(comes("Files from Ida Berg"));
}

TEST_F(Contacts, OfOtherNumbersLeaveTheTitle) {
  thePhone()({"contact", "add", "Ida Holm", "+821099998888"});
  thePhone()({"contact", "add", "Ida Berg", kSender});
  EXPECT_TRUE(comes("Files from Ida Berg"));
}
