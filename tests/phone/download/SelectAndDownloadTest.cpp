// From the received share over the select page to the files on the phone.

#include <filesystem>

#include "DownloadPage.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr const char* kSender = "+821011112222";

class SelectAndDownload : public DownloadPage {
 protected:
  static Share shareOfFive(Words* files) {
    *files = papers(5);
    return thePhone().share(*files);
  }

  static void downloadTwo(const Share& share) {
    ASSERT_TRUE(selectFrom(share));
    ASSERT_TRUE(tap("Paper 2.txt"));
    ASSERT_TRUE(tap("Paper 4.txt"));
    ASSERT_TRUE(tap("Done"));
  }
};

}  // namespace

TEST_F(SelectAndDownload, ShowsTheSelectionAtEachStep) {
  Words files;
  ASSERT_TRUE(selectFrom(shareOfFive(&files)));
  EXPECT_FALSE(thePhone().tree().enables("Done")) << thePhone().tree();
  EXPECT_EQ(thePhone().tree().items().size(), 6u) << thePhone().tree();
  ASSERT_TRUE(tap("Paper 2.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  EXPECT_TRUE(waitFor([] { return thePhone().tree().enables("Done"); }));
  ASSERT_TRUE(tap("Paper 4.txt"));
  ASSERT_TRUE(titleIs("2 selected"));
  EXPECT_EQ(selectedItems().size(), 2u) << thePhone().tree();
  ASSERT_TRUE(tap("Paper 4.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Paper 2.txt"));
  ASSERT_TRUE(titleIs(kNoFilesSelected));
  EXPECT_TRUE(waitFor([] { return !thePhone().tree().enables("Done"); })) << thePhone().tree();
}

TEST_F(SelectAndDownload, BringsExactlyTheSelectedFilesByteForByteAndMarksTheirCells) {
  Words files;
  downloadTwo(shareOfFive(&files));
  ASSERT_TRUE(saysNow("2 files downloaded"));
  EXPECT_EQ(contentOf(stored("Paper 2.txt")), contentOf(files[1]));
  EXPECT_EQ(contentOf(stored("Paper 4.txt")), contentOf(files[3]));
  EXPECT_EQ(filesIn(kFolder), 2u);
  EXPECT_TRUE(cellIs("Paper 2.txt", "downloaded"));
  EXPECT_TRUE(cellIs("Paper 4.txt", "downloaded"));
  EXPECT_TRUE(cellIs("Paper 3.txt", "not downloaded"));
  EXPECT_TRUE(downloadedCellsAre(2));
}

TEST_F(SelectAndDownload, HandsOverAddressesNamesAndSizesInTheOrderOfTheShare) {
  Words files;
  const Share share = shareOfFive(&files);
  downloadTwo(share);
  const HandOver request = handedOver();
  EXPECT_EQ(request.application, kDownloads);
  EXPECT_EQ(request.operation, "http://tizen.org/appcontrol/operation/view");
  const Extras expected = {{"remoteShare", {"download"}},
                           {"url", {addressOf(share, "file", 1), addressOf(share, "file", 3)}},
                           {"name", {"Paper 2.txt", "Paper 4.txt"}},
                           {"size", {"200", "400"}},
                           {"token", {share.token}},
                           {"sender", {kSender}},
                           {"sender_icon", {" "}},
                           {"all_downloaded", {"0"}},
                           {"wifi_check", {"0"}}};
  EXPECT_EQ(request.extras, expected);
}

TEST_F(SelectAndDownload, RecordsEntryCountKindsAndSize) {
  const Share share =
      thePhone().share({thePhone().makeFile("Song.mp3"), thePhone().makeFile("Film.mp4"),
                        thePhone().makeFile("Nothing known.qqq")});
  ASSERT_TRUE(selectFrom(share));
  ASSERT_TRUE(tap("Select all"));
  ASSERT_TRUE(titleIs("3 selected"));
  ASSERT_TRUE(tap("Done"));
  const Words expected = {"ZQ50 Push_notification",
                          "ZQ52 1_10",
                          "ZQ51 Audio",
                          "ZQ51 Video",
                          "ZQ51 Video",
                          "ZQ53 0_100MB"};
  EXPECT_TRUE(waitFor([&] { return newRecords().size() >= expected.size(); }));
  EXPECT_EQ(newRecords(), expected);
}

TEST_F(SelectAndDownload, RecordsTheCountAlsoWhenTheUserThenCancels) {
  ASSERT_TRUE(selectFrom(thePhone().share({makePicture(thePhone(), "Small.png", phone::kRed),
                                           thePhone().makeFile("Large.bin", 6291456)})));
  ASSERT_TRUE(tap("Select all"));
  ASSERT_TRUE(titleIs("2 selected"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(tapInPopup("Cancel"));
  const Words expected = {"ZQ50 Push_notification", "ZQ52 1_10"};
  EXPECT_TRUE(waitFor([&] { return newRecords() == expected; }));
  EXPECT_EQ(newRecords(), expected);
}

TEST_F(SelectAndDownload, RemembersWhatIsDownloadedAndDownloadsItAgain) {
  Words files;
  const Share share = shareOfFive(&files);
  downloadTwo(share);
  ASSERT_TRUE(downloadedCellsAre(2));
  thePhone().closeViewer();
  thePhone().launchReceived(share.token);
  EXPECT_TRUE(cellIs("Paper 2.txt", "downloaded"));
  EXPECT_TRUE(downloadedCellsAre(2));
  fs::remove(stored("Paper 2.txt"));
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(titleIs(kNoFilesSelected));
  ASSERT_TRUE(tap("Paper 2.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Done"));
  EXPECT_TRUE(waitFor([&] { return fs::exists(stored("Paper 2.txt")); }));
  EXPECT_EQ(contentOf(stored("Paper 2.txt")), contentOf(files[1]));
}
