// More than 6 MiB at once is asked about before; and the network that it takes.

#include <filesystem>

#include "DownloadPage.h"

namespace fs = std::filesystem;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr size_t kUnasked = 6291456;
constexpr const char* kPopup = "Alert, Download files";
constexpr const char* kWifiOnly = "Download via Wi-Fi only";

class WifiPopup : public DownloadPage {
 protected:
  /// Done with two files of so many bytes together.
  static void ask(size_t bytes) {
    ASSERT_TRUE(selectFrom(thePhone().share(
        {thePhone().makeFile("Film.mp4", bytes - 1000), thePhone().makeFile("Title.txt", 1000)})));
    ASSERT_TRUE(tap("Select all"));
    ASSERT_TRUE(titleIs("2 selected"));
    ASSERT_TRUE(tap("Done"));
  }

  static bool isTicked() {
    const auto tree = thePhone().tree();
    const auto* box = tree.named(kWifiOnly);
    return box && box->is("checked");
  }

  static testing::AssertionResult tick(bool isTickedThen) {
    thePhone()({"tap", kWifiOnly});
    if (waitFor([=] { return isTicked() == isTickedThen; })) return testing::AssertionSuccess();
    return testing::AssertionFailure() << thePhone().tree();
  }

  void isRefused(const std::string& message) const {
    ASSERT_TRUE(tapInPopup("Download"));
    EXPECT_TRUE(saysNow(message));
    EXPECT_TRUE(thePhone().tree().named(kPopup)) << thePhone().tree();
    EXPECT_EQ(newHandOvers().size(), 0u);
    EXPECT_TRUE(fs::is_empty(ofPhone(kFolder)));
  }
};

}  // namespace

TEST_F(WifiPopup, DoesNotComeForSixMebibytes) {
  ask(kUnasked);
  EXPECT_EQ(handedOver()["wifi_check"], Words{"0"});
  EXPECT_FALSE(thePhone().tree().named(kPopup)) << thePhone().tree();
  EXPECT_TRUE(saysNow("2 files downloaded"));
}

TEST_F(WifiPopup, ComesForOneByteMoreSaysHowMuchAndLeavesTheSelectionOnCancelAndBack) {
  ask(kUnasked + 1);
  ASSERT_TRUE(comes(kPopup));
  EXPECT_NE(thePhone().tree().text().find("6.00 MB"), std::string::npos) << thePhone().tree();
  EXPECT_FALSE(isTicked());
  ASSERT_TRUE(tapInPopup("Cancel"));
  ASSERT_TRUE(goes(kPopup));
  EXPECT_TRUE(titleIs("2 selected"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(comes(kPopup));
  thePhone()({"key", "Escape"});
  ASSERT_TRUE(goes(kPopup));
  EXPECT_TRUE(titleIs("2 selected"));
  EXPECT_EQ(newHandOvers().size(), 0u);
}

TEST_F(WifiPopup, HandsNothingOverWithWifiOnlyOnMobileDataUntilTheTickIsTakenAway) {
  thePhone()({"network", "cellular"});
  ask(kUnasked + 1);
  ASSERT_TRUE(comes(kPopup));
  ASSERT_TRUE(tick(true));
  isRefused(kNoWifi);
  ASSERT_TRUE(tick(false));
  ASSERT_TRUE(tapInPopup("Download"));
  EXPECT_EQ(handedOver()["wifi_check"], Words{"0"});
  EXPECT_TRUE(saysNow("2 files downloaded"));
  EXPECT_EQ(fs::file_size(stored("Film.mp4")), kUnasked + 1 - 1000);
}

TEST_F(WifiPopup, HandsNothingOverWithoutANetwork) {
  ask(kUnasked + 1);
  ASSERT_TRUE(comes(kPopup));
  thePhone()({"network", "none"});
  isRefused(kNoNetwork);
}

TEST_F(WifiPopup, HandsOverWithWifiOnlyOnWifi) {
  ask(kUnasked + 1);
  ASSERT_TRUE(comes(kPopup));
  ASSERT_TRUE(tick(true));
  ASSERT_TRUE(tapInPopup("Download"));
  EXPECT_EQ(handedOver()["wifi_check"], Words{"1"});
  EXPECT_TRUE(saysNow("2 files downloaded"));
  EXPECT_TRUE(downloadedCellsAre(2));
}

TEST_F(WifiPopup, IsNotNeededToSayThatThereIsNoNetwork) {
  ASSERT_TRUE(selectFrom(thePhone().share(papers(2))));
  ASSERT_TRUE(tap("Paper 1.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  thePhone()({"network", "none"});
  ASSERT_TRUE(tap("Done"));
  EXPECT_TRUE(saysNow(kNoNetwork));
  EXPECT_TRUE(titleIs("1 selected"));
  EXPECT_EQ(newHandOvers().size(), 0u);
}
