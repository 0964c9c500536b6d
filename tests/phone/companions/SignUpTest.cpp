#include "Companions.h"

using phone::thePhone;

namespace {

class SignUp : public testing::Test {
 protected:
  static void ask(const char* page) {
    thePhone()({"launch", "raw", std::string("http://tizen.org/appcontrol/operation/") + page,
                "--app", kSignUp, "server[]=keld"});
  }
};

}  // namespace

TEST_F(SignUp, MakesAnAccountWithTheSharingServiceOn) {
  thePhone()({"account", "none"});
  ask("auth");
  ASSERT_TRUE(comes("+821012345678, Phone number, at keld"));
  ASSERT_TRUE(tap("Sign up"));
  EXPECT_TRUE(says("Signed up"));
  ask("setting");
  EXPECT_TRUE(comes("Sharing service, On"));
}

TEST_F(SignUp, SwitchesTheSharingServiceOffAndOn) {
  thePhone()({"account", "on"});
  ask("setting");
  ASSERT_TRUE(tap("Sharing service, On"));
  EXPECT_TRUE(comes("Sharing service, Off"));
  ASSERT_TRUE(tap("Sharing service, Off"));
  EXPECT_TRUE(comes("Sharing service, On"));
}

TEST_F(SignUp, ComesBeforeTheSettingsOfAPhoneWithoutAnAccount) {
  thePhone()({"account", "none"});
  ask("setting");
  EXPECT_TRUE(comes("Sign up"));
}

TEST_F(SignUp, CanBeTriedAgainWhenTheServiceIsDown) {
  thePhone()({"account", "none"});
  thePhone()({"service", "down"});
  ask("auth");
  ASSERT_TRUE(tap("Sign up"));
  thePhone()({"service", "ok"});
  ASSERT_TRUE(tap("Sign up"));
  EXPECT_TRUE(goes("+821012345678, Phone number"));
}
