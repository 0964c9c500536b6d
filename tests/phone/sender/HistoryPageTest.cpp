// The phone's home: what was shared, in both directions.

#include "Screen.h"

using phone::thePhone;
using phone::waitFor;

namespace {

class HistoryPage : public Sending {
 protected:
  static testing::AssertionResult recordsEntry(const std::string& name) {
    const auto found = [&] {
      const auto entries = linesWith(thePhone(), "usage", "\"ZQ50\"");
      return !entries.empty() && entries.back().find('"' + name + '"') != std::string::npos;
    };
    if (waitFor(found)) return testing::AssertionSuccess();
    return testing::AssertionFailure() << thePhone()({"usage"});
  }
};

}  // namespace

TEST_F(HistoryPage, ListsWhatWasSentAndWhatWasReceived) {
  send({"outgoing.txt"});
  thePhone().shareTo(kOwnNumber, kThirdNumber, {thePhone().makeFile("incoming.txt")});
  openApplication(thePhone(), kHistory);
  EXPECT_TRUE(comes(thePhone(), std::string(kSecondNumber) + ", outgoing.txt · Sent on "));
  EXPECT_TRUE(comes(thePhone(), std::string(kThirdNumber) + ", incoming.txt · Received on "));
}

TEST_F(HistoryPage, OpensASentShareAndIsInFrontAgainAfterwards) {
  send({"outgoing.txt"});
  openApplication(thePhone(), kHistory);
  ASSERT_TRUE(tap(thePhone(), std::string(kSecondNumber) + ", outgoing.txt"));
  ASSERT_TRUE(comes(thePhone(), "Recall"));
  EXPECT_TRUE(recordsEntry("Shared_history_sent"));
  ASSERT_TRUE(tap(thePhone(), "Back"));
  EXPECT_TRUE(comes(thePhone(), "Sharing history"));
  EXPECT_TRUE(viewerEnds(thePhone()));
}

TEST_F(HistoryPage, OpensAReceivedShareAndIsInFrontAgainAfterwards) {
  thePhone().shareTo(kOwnNumber, kThirdNumber, {thePhone().makeFile("incoming.txt")});
  openApplication(thePhone(), kHistory);
  ASSERT_TRUE(tap(thePhone(), std::string(kThirdNumber) + ", incoming.txt"));
  ASSERT_TRUE(comes(thePhone(), "Download"));
  EXPECT_TRUE(recordsEntry("Shared_history_received"));
  thePhone()({"key", "Escape"});
  EXPECT_TRUE(comes(thePhone(), "Sharing history"));
}
