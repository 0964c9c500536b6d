#include "Companions.h"

using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

constexpr const char* kOwnNumber = "+821012345678";

class History : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    thePhone()({"contact", "add", "Maria Rossi", "+821055550001"});
    thePhone()({"contact", "add", "Tom Becker", "+821055550002"});
  }

  void TearDown() override { thePhone().closeViewer(); }

  static std::string lastLaunch() {
    const std::string all = thePhone()({"launches", "--all"});
    return all.substr(all.rfind('\n', all.size() - 2) + 1);
  }
};

}  // namespace

TEST_F(History, ListsWhatWasReceivedAndOpensIt) {
  const Share share = thePhone().shareTo(
      kOwnNumber, "+821055550001", {thePhone().makeFile("a.txt"), thePhone().makeFile("b.txt")});
  open(kHistory);
  ASSERT_TRUE(tap("Maria Rossi, 2 files"));
  EXPECT_TRUE(comes("a.txt, "));
  const std::string launch = lastLaunch();
  EXPECT_NE(launch.find("/operation/launch_viewer"), std::string::npos) << launch;
  EXPECT_NE(launch.find("[\"view_type\",\"received\"]"), std::string::npos) << launch;
  EXPECT_NE(launch.find(share.token), std::string::npos) << launch;
}

TEST_F(History, ListsWhatWasSentAndOpensIt) {
  const Share share =
      thePhone().shareTo("+821055550001,+821055550002", kOwnNumber, {thePhone().makeFile("c.txt")});
  open(kHistory);
  ASSERT_TRUE(tap("Maria Rossi, Tom Becker, c.txt"));
  EXPECT_TRUE(comes("Recall"));
  const std::string launch = lastLaunch();
  EXPECT_NE(launch.find("[\"view_type\",\"sent\"]"), std::string::npos) << launch;
  EXPECT_NE(launch.find("[\"request_id\",\"" + std::to_string(share.request) + "\"]"),
            std::string::npos)
      << launch;
}

TEST_F(History, ShowsANewShareWithoutBeingAsked) {
  open(kHistory);
  ASSERT_TRUE(comes("Sharing history"));
  thePhone().shareTo(kOwnNumber, "+821055550002", {thePhone().makeFile("fresh.txt")});
  EXPECT_TRUE(comes("Tom Becker, fresh.txt"));
}

TEST_F(History, DropsAShareThatWasRecalled) {
  thePhone()({"account", "on"});
  const Share share =
      thePhone().shareTo("+821055550002", kOwnNumber, {thePhone().makeFile("mistake.txt")});
  thePhone()({"launch", "sent", "--request", std::to_string(share.request)});
  ASSERT_TRUE(tap("Recall"));
  ASSERT_TRUE(tap("OK"));
  ASSERT_TRUE(
      waitFor([] { return thePhone()({"signals"}).find("\"recall\"") != std::string::npos; }));
  open(kHistory);
  ASSERT_TRUE(comes("Sharing history"));
  EXPECT_TRUE(goes("Tom Becker, mistake.txt"));
}

TEST_F(History, FollowsTheAddressBook) {
  thePhone().shareTo(kOwnNumber, "+821055550003", {thePhone().makeFile("d.txt")});
  open(kHistory);
  ASSERT_TRUE(comes("+821055550003, d.txt"));
  thePhone()({"contact", "add", "Yuki Mori", "+821055550003"});
  EXPECT_TRUE(comes("Yuki Mori, d.txt"));
}

TEST_F(History, StaysWhenOneWantsToLeaveIt) {
  open(kHistory);
  ASSERT_TRUE(comes("Sharing history"));
  thePhone()({"key", "Escape"});
  thePhone()({"key", "Escape"});
  EXPECT_TRUE(comes("Sharing history"));
}
