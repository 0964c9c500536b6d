// Sending a share on to others.

#include "Screen.h"

using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

class Reshare : public Sending {
 protected:
  static void SetUpTestSuite() {
    thePhone()({"contact", "add", "Kim Second", kSecondNumber});
    thePhone()({"contact", "add", "Lee Third", kThirdNumber});
  }
  static void TearDownTestSuite() {
    thePhone()({"contact", "remove", "Kim Second"});
    thePhone()({"contact", "remove", "Lee Third"});
  }

  static void openPicker(const Share& share) {
    openSent(thePhone(), share);
    ASSERT_TRUE(tap(thePhone(), "Reshare"));
    ASSERT_TRUE(comes(thePhone(), "Select recipients"));
  }

  static std::string extras(const Share& share, const std::string& operation) {
    return R"("extras":[["type","32"],["ct_max","10"],["ct_app_id","com.orlant.zelqo"],)"
           R"(["zq_reshare",")" +
           std::to_string(share.request) +
           R"("],["ct_operation","http://tizen.org/appcontrol/operation/)" + operation + "\"]]";
  }
};

}  // namespace

TEST_F(Reshare, OfSeveralFilesAsksThePickerForAShare) {
  const Share share = send({"a.txt", "b.txt"});
  const std::size_t before = linesWith(thePhone(), "usage", "\"ZQ58\"").size();
  openPicker(share);
  const std::string launch = thePhone().lines("launches").back();
  EXPECT_NE(launch.find(R"("app_id":"contacts-tabui-efl")"), std::string::npos) << launch;
  EXPECT_NE(launch.find(R"(/appcontrol/operation/default")"), std::string::npos) << launch;
  EXPECT_NE(launch.find(R"("launch_mode":"single")"), std::string::npos) << launch;
  EXPECT_NE(launch.find(extras(share, "share")), std::string::npos) << launch;
  EXPECT_TRUE(
      waitFor([&] { return linesWith(thePhone(), "usage", "\"ZQ58\"").size() == before + 1; }));
}

TEST_F(Reshare, OfOneFileAsksThePickerForAMultiShare) {
  const Share share = send({"a.txt"});
  openPicker(share);
  const std::string launch = thePhone().lines("launches").back();
  EXPECT_NE(launch.find(extras(share, "multi_share")), std::string::npos) << launch;
}

TEST_F(Reshare, LetsOneChooseFromTheAddressBook) {
  openPicker(send({"a.txt"}));
  const phone::Tree tree = thePhone().tree();
  EXPECT_TRUE(tree.named("Kim Second, +821099998888")) << tree;
  EXPECT_TRUE(tree.named("Lee Third, +821077776666")) << tree;
  EXPECT_FALSE(tree.enables("Send")) << tree;
}

TEST_F(Reshare, BringsTheFilesToSomebodyElsesPhone) {
  const auto recipient = secondPhone(thePhone());
  openPicker(send({"first.txt", "second.txt"}, kThirdNumber));
  ASSERT_TRUE(tap(thePhone(), "Kim Second"));
  ASSERT_TRUE(tap(thePhone(), "Send"));
  EXPECT_TRUE(says(thePhone(), "Sent"));
  EXPECT_TRUE(comes(thePhone(), "Reshare"));  // the page that it came from
  openApplication(*recipient, kHistory);
  ASSERT_TRUE(tap(*recipient, std::string(kOwnNumber) + ", 2 files"));
  EXPECT_TRUE(comes(*recipient, "first.txt"));
  EXPECT_TRUE(comes(*recipient, "second.txt"));
  openApplication(thePhone(), kHistory);
  EXPECT_TRUE(comes(thePhone(), "Kim Second, 2 files"));
  EXPECT_EQ(recipient->sanitizerFindings(), "");
}

TEST_F(Reshare, IsLeftWithoutSendingAnything) {
  openPicker(send({"kept.txt"}));
  thePhone()({"key", "Escape"});
  EXPECT_TRUE(comes(thePhone(), "Recall"));
  openApplication(thePhone(), kHistory);
  ASSERT_TRUE(comes(thePhone(), "Kim Second, kept.txt"));
  EXPECT_EQ(linesWith(thePhone(), "tree", "kept.txt").size(), 1u) << thePhone().tree();
}
