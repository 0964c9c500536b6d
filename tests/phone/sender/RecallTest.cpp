// Taking a share back.

#include "Screen.h"

using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

constexpr unsigned kOk = 200, kGone = 410;

class Recall : public Sending {
 protected:
  static std::size_t signals() { return linesWith(thePhone(), "signals", "\"recall\"").size(); }
  static std::size_t records() { return linesWith(thePhone(), "usage", "\"ZQ57\"").size(); }

  static void recall(const Share& share) {
    openSent(thePhone(), share);
    ASSERT_TRUE(tap(thePhone(), "Recall"));
    ASSERT_TRUE(tap(thePhone(), "OK"));
  }
};

}  // namespace

TEST_F(Recall, ThatIsCancelledChangesNothing) {
  const Share share = send({"a.txt"});
  const std::size_t before = signals();
  openSent(thePhone(), share);
  ASSERT_TRUE(tap(thePhone(), "Recall"));
  ASSERT_TRUE(tap(thePhone(), "Cancel"));
  EXPECT_TRUE(goes(thePhone(), "Cancel"));
  EXPECT_TRUE(comes(thePhone(), "Reshare"));
  EXPECT_EQ(signals(), before);
  EXPECT_EQ(statusOf(thePhone(), share, 0), kOk);
}

TEST_F(Recall, ShowsItsProgressUntilTheServiceAnswers) {
  const Share share = send({"a.txt"});
  openSent(thePhone(), share);
  ASSERT_TRUE(tap(thePhone(), "Recall"));
  ASSERT_TRUE(comes(thePhone(), "OK"));
  thePhone()({"service", "slow", "3600000"});
  ASSERT_TRUE(tap(thePhone(), "OK"));
  EXPECT_TRUE(comes(thePhone(), "Recalling files"));
}

TEST_F(Recall, TellsTheHistoryOnceAndEndsTheViewer) {
  const Share share = send({"a.txt", "b.txt"});
  ASSERT_EQ(statusOf(thePhone(), share, 1), kOk);
  const std::size_t before = signals(), recorded = records();
  recall(share);
  EXPECT_TRUE(viewerEnds(thePhone()));
  EXPECT_TRUE(waitFor([&] { return signals() > before; }));
  EXPECT_EQ(signals(), before + 1);
  EXPECT_EQ(records(), recorded + 1);
  const std::string signal = linesWith(thePhone(), "signals", "\"recall\"").back();
  EXPECT_NE(signal.find("\"default\""), std::string::npos) << signal;
  EXPECT_EQ(statusOf(thePhone(), share, 0), kGone);
  EXPECT_EQ(statusOf(thePhone(), share, 1), kGone);
}

TEST_F(Recall, MayBeAskedForAgain) {
  const Share share = send({"a.txt"});
  recall(share);
  ASSERT_TRUE(viewerEnds(thePhone()));
  const std::size_t before = signals();
  recall(share);
  EXPECT_TRUE(viewerEnds(thePhone()));
  EXPECT_TRUE(waitFor([&] { return signals() == before + 1; }));
  EXPECT_EQ(statusOf(thePhone(), share, 0), kGone);
}

TEST_F(Recall, TakesTheShareOutOfAHistoryThatIsOpen) {
  const Share share = send({"regret.txt"});
  openApplication(thePhone(), kHistory);
  ASSERT_TRUE(tap(thePhone(), std::string(kSecondNumber) + ", regret.txt"));
  ASSERT_TRUE(tap(thePhone(), "Recall"));
  ASSERT_TRUE(tap(thePhone(), "OK"));
  ASSERT_TRUE(viewerEnds(thePhone()));
  ASSERT_TRUE(comes(thePhone(), "Sharing history"));
  EXPECT_TRUE(goes(thePhone(), std::string(kSecondNumber) + ", regret.txt"));
}

TEST_F(Recall, ThatTheServiceRefusesKeepsItsProgressOnScreen) {
  const Share share = send({"a.txt"});
  const std::size_t before = signals();
  openSent(thePhone(), share);
  ASSERT_TRUE(tap(thePhone(), "Recall"));
  ASSERT_TRUE(comes(thePhone(), "OK"));
  thePhone()({"service", "refuse"});
  ASSERT_TRUE(tap(thePhone(), "OK"));
  EXPECT_TRUE(logs("Error happened(error_code = "));
  EXPECT_TRUE(comes(thePhone(), "Recalling files"));
  EXPECT_EQ(signals(), before);
}

TEST_F(Recall, MeetingAServiceThatIsDownKeepsItsProgressOnScreen) {
  const Share share = send({"a.txt"});
  openSent(thePhone(), share);
  ASSERT_TRUE(tap(thePhone(), "Recall"));
  ASSERT_TRUE(comes(thePhone(), "OK"));
  thePhone()({"service", "down"});
  ASSERT_TRUE(tap(thePhone(), "OK"));
  EXPECT_TRUE(comes(thePhone(), "Recalling files"));
  thePhone()({"service", "ok"});
  EXPECT_EQ(statusOf(thePhone(), share, 0), kOk);
}

TEST_F(Recall, ThatRunsWhileAnotherShareIsOpenedDoesNoHarm) {
  const Share share = send({"a.txt"});
  const Share other = send({"other.txt"});
  openSent(thePhone(), share);
  ASSERT_TRUE(tap(thePhone(), "Recall"));
  ASSERT_TRUE(comes(thePhone(), "OK"));
  thePhone()({"service", "slow", "1000"});
  ASSERT_TRUE(tap(thePhone(), "OK"));
  openSent(thePhone(), other);
  ASSERT_TRUE(comes(thePhone(), "other.txt"));
  EXPECT_TRUE(waitFor([&] { return statusOf(thePhone(), share, 0) == kGone; }));
  EXPECT_TRUE(comes(thePhone(), "other.txt"));
  EXPECT_FALSE(thePhone().tree().named("Recalling files"));
}

TEST_F(Recall, ReachesTheRecipientsPhone) {
  const auto recipient = secondPhone(thePhone());
  const Share share = send({"secret.txt", "plan.txt"});
  openApplication(*recipient, kHistory);
  ASSERT_TRUE(comes(*recipient, std::string(kOwnNumber) + ", 2 files"));
  recipient->launchReceived(share.token);
  ASSERT_TRUE(comes(*recipient, "secret.txt"));
  EXPECT_TRUE(recipient->tree().enables("Download"));
  recipient->closeViewer();
  recall(share);
  ASSERT_TRUE(viewerEnds(thePhone()));
  ASSERT_TRUE(comes(*recipient, std::string(kOwnNumber) + ", 2 files · Recalled"));
  recipient->launchReceived(share.token);
  ASSERT_TRUE(comes(*recipient, "Download"));
  const phone::Tree tree = recipient->tree();
  EXPECT_FALSE(tree.enables("Download")) << tree;
  EXPECT_FALSE(tree.named("secret.txt")) << tree;
  EXPECT_EQ(statusOf(thePhone(), share, 0), kGone);
  EXPECT_EQ(recipient->sanitizerFindings(), "");
}
