#include "ZQVWifiSelectPopup.h"

#include "ViewTest.h"
#include "ZQVUnableOpenFilePopup.h"

using testing::ElementsAre;

namespace {

constexpr int kLanguageChanged = 13;
constexpr const char* kFileGone =
    "IDS_RSH_POP_THE_FILE_WAS_DELETED_MOVED_OR_RENAMED_DOWNLOAD_THE_FILE_AND_TRY_AGAIN";

}  // namespace

class WifiPopup : public ViewTest {
 protected:
  void open(uint64_t size) {
    slot = new ZQVWifiSelectPopup(size, &slot);
    slot->setDownloadCb([this](bool* close) {
      ++downloads;
      wasWifiOnly = slot->isWifiOnly();
      *close = true;
    });
    top()->attachPopup(slot);
    ASSERT_TRUE(waitForPopup());
  }
  static Evas_Object* content(const char* part) {
    return elm_object_part_content_get(elm_object_content_get(popup()), part);
  }
  static void tick(bool isTicked) {
    elm_check_state_set(content("elm.swallow.check"), isTicked);
    evas_object_smart_callback_call(content("elm.swallow.check"), "changed", nullptr);
  }
  bool goes() {
    return waitUntil([this] { return !slot; });
  }

  ZQVWifiSelectPopup* slot = nullptr;
  int downloads = 0;
  bool wasWifiOnly = false;
};

TEST_F(WifiPopup, TellsTheSizeWithTwoDecimals) {
  open(10485760);
  EXPECT_EQ(textOf(content("elm.swallow.end")),
            zqvFormat("IDS_RSH_POP_THE_TOTAL_FILE_SIZE_IS_OVER_P1SS_P2SS_TO_AVOID_MSG", "ss",
                      "10.00", "MB"));
}

TEST_F(WifiPopup, TellsSizesBeyond32Bits) {
  open(5368709120);
  EXPECT_EQ(textOf(content("elm.swallow.end")),
            zqvFormat("IDS_RSH_POP_THE_TOTAL_FILE_SIZE_IS_OVER_P1SS_P2SS_TO_AVOID_MSG", "ss",
                      "5120.00", "MB"));
}

TEST_F(WifiPopup, HasTitleCheckAndTwoButtons) {
  open(1);
  EXPECT_EQ(textOf(popup(), "title,text"), zqvText("IDS_RSH_HEADER_DOWNLOAD_FILES"));
  EXPECT_EQ(textOf(content("elm.swallow.check")),
            zqvText("IDS_RSH_OPT_DOWNLOAD_VIA_WI_FI_ONLY_ABB"));
  EXPECT_EQ(textOf(popupButton(1)), zqvText("IDS_RSH_BUTTON_CANCEL_ABB2"));
  EXPECT_EQ(textOf(popupButton(2)), zqvText("IDS_RSH_BUTTON_DOWNLOAD_ABB3"));
  EXPECT_FALSE(elm_check_state_get(content("elm.swallow.check")));
  EXPECT_FALSE(slot->isWifiOnly());
}

TEST_F(WifiPopup, ClosesOnCancelWithoutDownloading) {
  open(1);
  click(popupButton(1));
  EXPECT_TRUE(goes());
  EXPECT_EQ(downloads, 0);
}

TEST_F(WifiPopup, StaysOpenAfterDownloadWhateverTheCallbackAnswers) {
  open(1);
  click(popupButton(2));
  EXPECT_EQ(downloads, 1);
  EXPECT_NE(slot, nullptr);
  click(popupButton(2));
  EXPECT_EQ(downloads, 2);
}

TEST_F(WifiPopup, NeedsNoCallback) {
  open(1);
  slot->setDownloadCb(nullptr);
  click(popupButton(2));
  EXPECT_NE(slot, nullptr);
}

TEST_F(WifiPopup, TellsTheWishForWifi) {
  open(1);
  tick(true);
  EXPECT_TRUE(slot->isWifiOnly());
  click(popupButton(2));
  EXPECT_TRUE(wasWifiOnly);
  tick(false);
  EXPECT_FALSE(slot->isWifiOnly());
  click(popupButton(2));
  EXPECT_FALSE(wasWifiOnly);
}

TEST_F(WifiPopup, MayBeClosedByItsCallback) {
  open(1);
  slot->setDownloadCb([this](bool*) { slot->close(); });
  click(popupButton(2));
  EXPECT_TRUE(goes());
}

TEST_F(WifiPopup, MayLoseItsPageInItsCallback) {
  bool isGone = false;
  push(new Watched<BlankPage>(&isGone));
  open(1);
  slot->setDownloadCb([this](bool*) { naviframe.pop(); });
  click(popupButton(2));
  EXPECT_TRUE(waitUntil([&] { return isGone; }));
  EXPECT_EQ(slot, nullptr);
}

TEST_F(WifiPopup, ShowsTheDeletedFileMessageAfterALanguageChange) {
  open(10485760);
  slot->update(kLanguageChanged);
  EXPECT_EQ(textOf(content("elm.swallow.end")), zqvText(kFileGone));
  EXPECT_EQ(textOf(popup(), "title,text"), zqvText("IDS_RSH_HEADER_DOWNLOAD_FILES"));
  EXPECT_EQ(textOf(content("elm.swallow.check")),
            zqvText("IDS_RSH_OPT_DOWNLOAD_VIA_WI_FI_ONLY_ABB"));
}

TEST_F(WifiPopup, IgnoresOtherEvents) {
  open(10485760);
  const std::string before = textOf(content("elm.swallow.end"));
  for (const int event : {0, 12, 14, 16}) slot->update(event);
  EXPECT_EQ(textOf(content("elm.swallow.end")), before);
}

TEST_F(WifiPopup, LogsMissingButtons) {
  open(1);
  elm_object_part_content_set(popup(), "button2", nullptr);
  slot->update(kLanguageChanged);
  EXPECT_THAT(log.errors(), ElementsAre("btn2 is null!"));
  elm_object_part_content_set(popup(), "button1", nullptr);
  log.clear();
  slot->update(kLanguageChanged);
  EXPECT_THAT(log.errors(), ElementsAre("btn1 is null!"));
}

TEST_F(WifiPopup, LogsACheckWithoutItsPopup) {
  ZQVWifiSelectPopup::_wifiCheckChangedCb(nullptr, nullptr, nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("data is NULL"));
}

TEST_F(WifiPopup, LeavesTheSlotToANewerPopup) {
  open(1);
  slot->close();
  auto* newer = new ZQVWifiSelectPopup(2, &slot);
  slot = newer;
  top()->attachPopup(newer);
  EXPECT_TRUE(waitUntil([] { return popup() != nullptr; }));
  EXPECT_EQ(slot, newer);
}

class UnableToOpenPopup : public ViewTest {
 protected:
  UnableToOpenPopup() {
    slot = new ZQVUnableOpenFilePopup(&slot);
    slot->setDownloadCb([this](bool* close) {
      ++downloads;
      *close = false;
    });
    top()->attachPopup(slot);
    EXPECT_TRUE(waitForPopup());
  }
  bool goes() {
    return waitUntil([this] { return !slot; });
  }

  ZQVUnableOpenFilePopup* slot = nullptr;
  int downloads = 0;
};

TEST_F(UnableToOpenPopup, SaysWhatHappened) {
  EXPECT_EQ(textOf(popup(), "title,text"), zqvText("IDS_RSH_HEADER_UNABLE_TO_OPEN_FILE_ABB"));
  EXPECT_EQ(textOf(popup()), zqvText(kFileGone));
  EXPECT_EQ(textOf(popupButton(1)), zqvText("IDS_RSH_BUTTON_CANCEL_ABB2"));
  EXPECT_EQ(textOf(popupButton(2)), zqvText("IDS_RSH_BUTTON_DOWNLOAD_ABB3"));
}

TEST_F(UnableToOpenPopup, ClosesOnCancelWithoutDownloading) {
  click(popupButton(1));
  EXPECT_TRUE(goes());
  EXPECT_EQ(downloads, 0);
}

TEST_F(UnableToOpenPopup, ClosesAfterDownloadWhateverTheCallbackAnswers) {
  click(popupButton(2));
  EXPECT_TRUE(goes());
  EXPECT_EQ(downloads, 1);
}

TEST_F(UnableToOpenPopup, ClosesWithoutACallbackToo) {
  slot->setDownloadCb(nullptr);
  click(popupButton(2));
  EXPECT_TRUE(waitForNoPopup());
}

TEST_F(UnableToOpenPopup, SetsItsTextsAgainWhenTheLanguageChanges) {
  elm_object_text_set(popupButton(1), "old");
  elm_object_text_set(popupButton(2), "old");
  slot->update(14);
  EXPECT_EQ(textOf(popupButton(1)), "old");
  slot->update(kLanguageChanged);
  EXPECT_EQ(textOf(popupButton(1)), zqvText("IDS_RSH_BUTTON_CANCEL_ABB2"));
  EXPECT_EQ(textOf(popupButton(2)), zqvText("IDS_RSH_BUTTON_DOWNLOAD_ABB3"));
  EXPECT_EQ(textOf(popup()), zqvText(kFileGone));
}

TEST_F(UnableToOpenPopup, LogsMissingButtons) {
  elm_object_part_content_set(popup(), "button2", nullptr);
  slot->update(kLanguageChanged);
  EXPECT_THAT(log.errors(), ElementsAre("btn2 is null!"));
  elm_object_part_content_set(popup(), "button1", nullptr);
  log.clear();
  slot->update(kLanguageChanged);
  EXPECT_THAT(log.errors(), ElementsAre("btn1 is null!"));
}
