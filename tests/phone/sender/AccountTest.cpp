// Recall and Reshare need an account with the sharing service switched on.

#include "Screen.h"

using phone::thePhone;

namespace {

class Account : public Sending {
 protected:
  static std::string lastLaunch() {
    const auto launches = thePhone().lines("launches");
    return launches.empty() ? "" : launches.back();
  }
};

}  // namespace

TEST_F(Account, IsThereOnANewPhone) {
  const phone::Phone fresh("phone_sender_test_new");
  const phone::Share share =
      fresh.shareTo(kSecondNumber, kOwnNumber, {fresh.makeFile("first.txt")});
  openSent(fresh, share);
  ASSERT_TRUE(tap(fresh, "Recall"));
  EXPECT_TRUE(comes(fresh, "OK"));
}

TEST_F(Account, ThatIsMissingIsMadeOnTheSignUpPageAndRecallThenAsks) {
  const phone::Phone& phone = thePhone();
  openSent(phone, send({"a.txt"}));
  ASSERT_TRUE(comes(phone, "Recall"));
  phone({"account", "none"});
  ASSERT_TRUE(tap(phone, "Recall"));
  ASSERT_TRUE(comes(phone, "+821012345678, Phone number, at keld"));
  EXPECT_TRUE(logs("Ovu NOK!"));
  EXPECT_NE(lastLaunch().find("/appcontrol/operation/auth\""), std::string::npos) << lastLaunch();
  EXPECT_NE(lastLaunch().find("[\"server\",[\"keld\"]]"), std::string::npos) << lastLaunch();
  ASSERT_TRUE(tap(phone, "Sign up"));
  ASSERT_TRUE(says(phone, "Signed up"));
  ASSERT_TRUE(tap(phone, "Recall"));
  EXPECT_TRUE(comes(phone, "OK"));
}

TEST_F(Account, ThatIsMissingStaysMissingWhenTheSignUpPageIsLeft) {
  const phone::Phone& phone = thePhone();
  openSent(phone, send({"a.txt"}));
  ASSERT_TRUE(comes(phone, "Reshare"));
  phone({"account", "none"});
  ASSERT_TRUE(tap(phone, "Reshare"));
  ASSERT_TRUE(comes(phone, "Sign up"));
  phone({"key", "Escape"});
  ASSERT_TRUE(tap(phone, "Recall"));
  EXPECT_TRUE(comes(phone, "Sign up"));
  EXPECT_FALSE(phone.tree().named("OK"));
}

TEST_F(Account, WithTheSharingServiceOffIsSwitchedOnInItsSettings) {
  const phone::Phone& phone = thePhone();
  openSent(phone, send({"a.txt"}));
  ASSERT_TRUE(comes(phone, "Recall"));
  phone({"account", "off"});
  ASSERT_TRUE(tap(phone, "Recall"));
  ASSERT_TRUE(comes(phone, "Sharing service, Off"));
  EXPECT_TRUE(logs("ZQ NOK!"));
  EXPECT_NE(lastLaunch().find("/appcontrol/operation/setting\""), std::string::npos)
      << lastLaunch();
  ASSERT_TRUE(tap(phone, "Sharing service, Off"));
  ASSERT_TRUE(comes(phone, "Sharing service, On"));
  phone({"key", "Escape"});
  ASSERT_TRUE(tap(phone, "Recall"));
  EXPECT_TRUE(comes(phone, "OK"));
}

TEST_F(Account, OfAPhoneThatWasToldToHaveNoneIsNotMadeAgain) {
  const std::string name = "phone_sender_test_new";
  phone::Phone phone(name);
  phone({"account", "none"});
  phone({"down"});
  phone({"up", "--headless"});
  const phone::Share share =
      phone.shareTo(kSecondNumber, kOwnNumber, {phone.makeFile("first.txt")});
  openSent(phone, share);
  ASSERT_TRUE(tap(phone, "Recall"));
  EXPECT_TRUE(comes(phone, "Sign up"));
}
