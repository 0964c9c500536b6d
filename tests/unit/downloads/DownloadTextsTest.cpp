// What the list of downloads says, in English.

#include "DownloadTexts.h"

#include <gtest/gtest.h>

using downloads::detailOf;
using downloads::Download;
using downloads::State;
using downloads::timeLeftText;

TEST(TimeLeft, IsGivenInSecondsUpToAMinute) {
  EXPECT_EQ(timeLeftText(0.0), "0 s left");
  EXPECT_EQ(timeLeftText(0.2), "1 s left");
  EXPECT_EQ(timeLeftText(59.0), "59 s left");
}

TEST(TimeLeft, IsGivenInMinutesUpToAnHour) {
  EXPECT_EQ(timeLeftText(59.1), "1 min 0 s left");
  EXPECT_EQ(timeLeftText(80.0), "1 min 20 s left");
  EXPECT_EQ(timeLeftText(3599.0), "59 min 59 s left");
}

TEST(TimeLeft, IsGivenInHoursBeyond) {
  EXPECT_EQ(timeLeftText(3600.0), "1 h 0 min left");
  EXPECT_EQ(timeLeftText(9000.0), "2 h 30 min left");
}

TEST(TimeLeft, IsEmptyWhileNobodyKnows) {
  EXPECT_EQ(timeLeftText(std::nullopt), "");
}

TEST(Detail, SaysHowMuchHasComeAndOfHowMuchWhenThatIsKnown) {
  Download download;
  download.state = State::Running;
  download.received = 512;
  EXPECT_EQ(detailOf(download, false), "512 B");
  download.size = 2048;
  EXPECT_EQ(detailOf(download, false), "512 B of 2.0 KB");
}

TEST(Detail, SaysWhatADownloadWaitsFor) {
  Download download;
  EXPECT_EQ(detailOf(download, false), "Waiting");
  EXPECT_EQ(detailOf(download, true), "Waiting for a network");
  download.wifiOnly = true;
  EXPECT_EQ(detailOf(download, true), "Waiting for Wi-Fi");
}
