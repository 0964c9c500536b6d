#include "Companions.h"

using phone::Share;
using phone::thePhone;

namespace {

constexpr const char* kOwnNumber = "+821012345678";

class Picker : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    thePhone()({"contact", "add", "Olga Ivanova", "+821066660001"});
    thePhone()({"contact", "add", "Pedro Silva", "+821066660002"});
  }

  static void ask(const std::string& share, const std::string& most) {
    thePhone()({"launch", "raw", "default", "--app", kPicker, "zq_reshare=" + share,
                "ct_max=" + most,
                "ct_operation=http://tizen.org/appcontrol/operation/multi_share"});
    // A page that still slides in does not take a finger.
    thePhone()({"painted", "2"});
  }
};

}  // namespace

TEST_F(Picker, SendsAShareOnToTheChosenOnes) {
  const Share share =
      thePhone().shareTo("+821066660001", kOwnNumber, {thePhone().makeFile("again.txt")});
  ask(std::to_string(share.request), "10");
  ASSERT_TRUE(comes("Olga Ivanova, "));
  EXPECT_FALSE(thePhone().tree().enables("Send"));
  ASSERT_TRUE(tap("Pedro Silva, "));
  ASSERT_TRUE(tap("Send"));
  EXPECT_TRUE(says("Sent"));
  open(kHistory);
  EXPECT_TRUE(comes("Pedro Silva, again.txt"));
}

TEST_F(Picker, LetsNoMoreBeChosenThanAsked) {
  const Share share =
      thePhone().shareTo("+821066660001", kOwnNumber, {thePhone().makeFile("again.txt")});
  ask(std::to_string(share.request), "1");
  ASSERT_TRUE(tap("Olga Ivanova, "));
  ASSERT_TRUE(comes("1 selected"));
  ASSERT_TRUE(tap("Pedro Silva, "));
  EXPECT_TRUE(says("No more than 1 at once"));
}

TEST_F(Picker, SaysThatAShareIsNoLongerThere) {
  ask("99999", "10");
  ASSERT_TRUE(tap("Olga Ivanova, "));
  ASSERT_TRUE(tap("Send"));
  EXPECT_TRUE(says("no longer on the phone"));
}
