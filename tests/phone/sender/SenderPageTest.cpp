// The page of a share that this phone has sent.

#include <algorithm>

#include "Picture.h"
#include "Screen.h"

using phone::thePhone;
using phone::Tree;

namespace {

constexpr const char* kFriend = "+821055550011";

class SenderPage : public Sending {
 protected:
  void TearDown() override {
    thePhone().command({"contact", "remove", "Anna Lindqvist"});
    Sending::TearDown();
  }

  /// Puts a person with that photo into the address book.
  static void addAnna(const std::string& photo) {
    thePhone()({"contact", "add", "Anna Lindqvist", kFriend, photo});
  }

  static const phone::Widget* rowPicture(const Tree& tree) {
    const auto& all = tree.widgets();
    const auto found = std::find_if(all.begin(), all.end(), [](const phone::Widget& widget) {
      return widget.role == "image" && widget.area.width == widget.area.height;
    });
    return found == all.end() ? nullptr : &*found;
  }

  /// Tells pictures of recipients apart; the same for the same picture.
  static std::string pictureOf(const std::string& recipients) {
    openSent(thePhone(), send({"a.txt"}, recipients));
    thePhone()({"painted", "1"});
    const Tree tree = thePhone().tree();
    const phone::Widget* picture = rowPicture(tree);
    const std::string pixels = picture ? phone::pixelsOf(thePhone(), picture->area) : "";
    EXPECT_NE(pixels, "") << tree;
    return std::to_string(std::hash<std::string>()(pixels));
  }
};

}  // namespace

TEST_F(SenderPage, NamesTheNumberOfARecipientWhoIsNotInTheAddressBook) {
  openSent(thePhone(), send({"a.txt", "b.txt", "c.txt"}));
  ASSERT_TRUE(shows(thePhone(), 3));
  const Tree tree = thePhone().tree();
  EXPECT_TRUE(tree.named("Shared files")) << tree;
  EXPECT_TRUE(tree.named("Recipient")) << tree;
  EXPECT_TRUE(tree.named(kSecondNumber)) << tree;
  EXPECT_TRUE(tree.enables("Recall")) << tree;
  EXPECT_TRUE(tree.enables("Reshare")) << tree;
}

TEST_F(SenderPage, NamesTheOnlyRecipientAsTheAddressBookDoes) {
  addAnna(CONTACT_PHOTO);
  openSent(thePhone(), send({"a.txt"}, kFriend));
  EXPECT_TRUE(comes(thePhone(), "Anna Lindqvist"));
  EXPECT_FALSE(thePhone().tree().named(kFriend));
}

TEST_F(SenderPage, CutsTheRecipientsPhotoToACircle) {
  addAnna(CONTACT_PHOTO);
  openSent(thePhone(), send({"a.txt"}, kFriend));
  ASSERT_TRUE(comes(thePhone(), "Anna Lindqvist"));
  const Tree tree = thePhone().tree();
  const phone::Widget* picture = rowPicture(tree);
  ASSERT_TRUE(picture) << tree;
  const phone::Area area = picture->area;
  EXPECT_EQ(area.width, 74) << tree;
  const int row = area.right() + 12;  // between picture and name
  const auto at = [](int x, int y) { return phone::colourAt(thePhone(), x, y); };
  EXPECT_EQ(at(area.x + 1, area.y + 1), at(row, area.y + 1));
  const int middle = area.y + area.height / 2;
  EXPECT_NE(at(area.x + area.width / 2, middle), at(row, middle));
}

TEST_F(SenderPage, ShowsTheDefaultPictureForAPhotoThatIsNone) {
  addAnna(thePhone().makeFile("photo.jpg"));  // noise
  const std::string picture = pictureOf(kFriend);
  EXPECT_TRUE(comes(thePhone(), "Anna Lindqvist"));
  EXPECT_EQ(picture, pictureOf(kSecondNumber));
}

TEST_F(SenderPage, CountsSeveralRecipientsAndJoinsTheirNames) {
  addAnna(CONTACT_PHOTO);
  openSent(thePhone(), send({"a.txt"}, std::string(kFriend) + "," + kSecondNumber));
  EXPECT_TRUE(comes(thePhone(), "Recipients (2)"));
  EXPECT_TRUE(comes(thePhone(), std::string("Anna Lindqvist,") + kSecondNumber));
}

TEST_F(SenderPage, ShowsThePictureOfAGroupForSeveralRecipientsWhoeverTheyAre) {
  addAnna(CONTACT_PHOTO);
  const std::string withAnna = pictureOf(std::string(kFriend) + "," + kSecondNumber);
  EXPECT_EQ(withAnna, pictureOf(std::string(kThirdNumber) + "," + kSecondNumber));
  EXPECT_NE(withAnna, pictureOf(kFriend));
  EXPECT_NE(withAnna, pictureOf(kSecondNumber));
}

TEST_F(SenderPage, FollowsTheAddressBook) {
  openSent(thePhone(), send({"a.txt"}, kFriend));
  ASSERT_TRUE(comes(thePhone(), kFriend));
  addAnna(CONTACT_PHOTO);
  EXPECT_TRUE(comes(thePhone(), "Anna Lindqvist"));
}

TEST_F(SenderPage, ShowsFiftyFiles) {
  phone::Words names;
  for (int i = 1; i <= 50; i++) names.push_back("File " + std::to_string(i) + ".txt");
  openSent(thePhone(), send(names));
  EXPECT_TRUE(shows(thePhone(), 50));
}

TEST_F(SenderPage, OpensAFileAndComesBack) {
  openSent(thePhone(), send({"a.txt", "b.txt"}));
  ASSERT_TRUE(tap(thePhone(), "b.txt"));
  ASSERT_TRUE(comes(thePhone(), "Open"));
  thePhone()({"key", "Escape"});
  EXPECT_TRUE(comes(thePhone(), "Recall"));
}

TEST_F(SenderPage, EndsTheViewerOnItsBackButton) {
  openSent(thePhone(), send({"a.txt"}));
  ASSERT_TRUE(tap(thePhone(), "Back"));
  EXPECT_TRUE(viewerEnds(thePhone()));
}

TEST_F(SenderPage, OfAShareThatIsNotThereIsNeverShown) {
  thePhone()({"launch", "sent", "--request", "4000000"});
  EXPECT_TRUE(logs("Unexpected SAPI error(get SAPI handle failed)!"));
  openSent(thePhone(), send({"good.txt"}));
  EXPECT_TRUE(comes(thePhone(), "good.txt"));
}
