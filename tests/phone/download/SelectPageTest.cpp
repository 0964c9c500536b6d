// The select page itself: many files, and leaving it.

#include "DownloadPage.h"
#include "FullPage.h"

using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

using SelectPage = DownloadPage;

size_t checkBoxes(bool isChecked) {
  size_t count = 0;
  for (const auto& box : thePhone().tree().withRole("check box")) {
    count += box.is("showing") && box.is("checked") == isChecked;
  }
  return count;
}

/// How far one swipe goes depends on how busy the machine is.
void scrollTo(const std::string& name) {
  EXPECT_TRUE(waitFor([&] {
    if (thePhone().tree().shows(name)) return true;
    thePhone()({"swipe", "360,1200", "360,400", "400"});
    return false;
  })) << thePhone().tree();
}

/// Two files checked, and away; then nothing is checked any more.
void leaveWithChecks(const Words& command) {
  ASSERT_TRUE(tap("Paper 1.txt"));
  ASSERT_TRUE(tap("Paper 3.txt"));
  ASSERT_TRUE(titleIs("2 selected"));
  thePhone()(command);
  ASSERT_TRUE(goes("Done"));
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(titleIs(kNoFilesSelected));
  EXPECT_EQ(selectedItems(), Words());
  EXPECT_EQ(checkBoxes(true), 0u) << thePhone().tree();
}

}  // namespace

TEST_F(SelectPage, LeavesNoChecksBehindOnCancelAndOnBack) {
  ASSERT_TRUE(selectFrom(thePhone().share(papers(3))));
  leaveWithChecks({"tap", "Cancel"});
  leaveWithChecks({"key", "Escape"});
  ASSERT_TRUE(tap("Paper 2.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Done"));
  EXPECT_EQ(handedOver()["name"], Words{"Paper 2.txt"});
}

TEST_F(SelectPage, SelectsNothingThatWasDownloadedFromItsOwnPage) {
  const Share share = thePhone().share(papers(3));
  thePhone().launchReceived(share.token);
  ASSERT_TRUE(tap("Paper 1.txt"));
  ASSERT_TRUE(pageIs("Paper 1.txt"));
  thePhone()({"painted"});
  ASSERT_TRUE(download());
  thePhone()({"key", "Escape"});
  ASSERT_TRUE(cellIs("Paper 1.txt", "downloaded"));
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(titleIs(kNoFilesSelected));
  EXPECT_EQ(selectedItems(), Words());
  EXPECT_EQ(checkBoxes(true), 0u) << thePhone().tree();
  ASSERT_TRUE(tap("Paper 2.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(saysNow("Paper 2.txt downloaded"));
  EXPECT_EQ(newHandOvers().back()["name"], Words{"Paper 2.txt"});
}

TEST_F(SelectPage, SelectsAndDeselectsAllOfMoreFilesThanFitOnTheScreen) {
  ASSERT_TRUE(selectFrom(thePhone().share(papers(36))));
  ASSERT_TRUE(tap("Select all"));
  ASSERT_TRUE(titleIs("36 selected"));
  EXPECT_EQ(selectedItems().size(), 37u) << thePhone().tree();
  EXPECT_TRUE(waitFor([] { return checkBoxes(false) == 0; })) << thePhone().tree();
  scrollTo("Paper 36.txt");
  EXPECT_TRUE(waitFor([] { return checkBoxes(false) == 0; })) << thePhone().tree();
  ASSERT_TRUE(tap("Select all"));
  ASSERT_TRUE(titleIs(kNoFilesSelected));
  EXPECT_EQ(selectedItems(), Words());
  EXPECT_TRUE(waitFor([] { return checkBoxes(true) == 0; })) << thePhone().tree();
}

TEST_F(SelectPage, DownloadsAllOfTwoHundredFilesAndLogsNoError) {
  constexpr size_t kFiles = 200;
  const Words files = papers(kFiles);
  ASSERT_TRUE(selectFrom(thePhone().share(files)));
  errorsCountFromHere();
  ASSERT_TRUE(tap("Select all"));
  ASSERT_TRUE(titleIs("200 selected"));
  ASSERT_TRUE(tap("Done"));
  EXPECT_EQ(handedOver()["url"].size(), kFiles);
  ASSERT_TRUE(saysNow("200 files downloaded"));
  EXPECT_EQ(filesIn(kFolder), kFiles);
  for (size_t i = 0; i < kFiles; i++) {
    ASSERT_EQ(contentOf(stored("Paper " + std::to_string(i + 1) + ".txt")), contentOf(files[i]));
  }
  EXPECT_TRUE(downloadedCellsAre(kFiles));
  EXPECT_EQ(newErrors(), Words());
  // More than a hundred files are no bucket.
  for (const std::string& record : newRecords()) EXPECT_NE(record.substr(0, 4), "ZQ52");
}

TEST_F(SelectPage, NamesItsCellsInTheLanguageOfNow) {
  ASSERT_TRUE(selectFrom(thePhone().share(papers(2))));
  ASSERT_TRUE(tap("Paper 1.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  thePhone()({"language", "de_DE.UTF-8"});
  EXPECT_TRUE(comes("Paper 1.txt, 100,0B, Text, nicht heruntergeladen, ausgewählt"));
  EXPECT_TRUE(comes("Paper 2.txt, 200,0B, Text, nicht heruntergeladen"));
}

TEST_F(SelectPage, ShowsNoFilesThatAreOnTheirWay) {
  const Share share = thePhone().share(papers(2));
  ASSERT_TRUE(selectFrom(share));
  thePhone()({"service", "slow", "3600000"});
  ASSERT_TRUE(tap("Paper 1.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(cellIs("Paper 1.txt", "downloading"));
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(titleIs(kNoFilesSelected));
  EXPECT_TRUE(comes("Paper 2.txt"));
  EXPECT_EQ(thePhone().tree().items().size(), 2u) << thePhone().tree();
}
