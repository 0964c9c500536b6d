// The download application's own window while something goes on.

#include <filesystem>

#include "DownloadPage.h"
#include "Transfers.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

constexpr size_t kMegabytes = 4;  // as much as is downloaded without a question

class DownloadWindow : public DownloadPage {
 protected:
  /// The window with one download that has stopped half way.
  void openHalfWay(const std::string& name) {
    _share = _gate.share(name, kMegabytes);
    ASSERT_TRUE(selectFrom(_share));
    ASSERT_TRUE(tap(name));
    ASSERT_TRUE(titleIs("1 selected"));
    ASSERT_TRUE(tap("Done"));
    ASSERT_TRUE(_gate.isReached());
    open(kDownloads);
    ASSERT_TRUE(comes("Downloads"));
  }

  /// Asks for a small file as the viewer would.
  static void ask(const std::string& name, const char* wifiOnly) {
    const Share share = thePhone().share({thePhone().makeFile(name, 2000)});
    thePhone()({"launch", "raw", "view", "--app", kDownloads,
                "url[]=" + addressOf(share, "file", 0), "name[]=" + name, "size[]=2000",
                std::string("wifi_check=") + wifiOnly});
  }

  static void allIsNamed(const phone::Tree& tree) {
    for (const auto& widget : tree.widgets()) {
      const bool isTold = widget.role == "push button" || widget.role == "progress bar" ||
                          (widget.role == "list item" && widget.is("showing"));
      EXPECT_TRUE(!isTold || !widget.name.empty()) << tree;
    }
  }

  Gate _gate{kMegabytes * kMegabyte / 2};
  Share _share;
};

}  // namespace

TEST_F(DownloadWindow, ShowsHowFarADownloadHasCome) {
  openHalfWay("Half.mp4");
  ASSERT_TRUE(comes("Half.mp4, 2.0 MB of 4.0 MB"));
  const auto tree = thePhone().tree();
  EXPECT_TRUE(tree.shows("Progress: Half.mp4")) << tree;
  EXPECT_TRUE(tree.shows("Progress: 1 file, 2.0 MB of 4.0 MB")) << tree;
  allIsNamed(tree);
  _gate.open();
  EXPECT_TRUE(comes("Half.mp4, Downloaded, 4.0 MB"));
  EXPECT_TRUE(goes("Progress: "));
}

TEST_F(DownloadWindow, CancelsAndTheShareOffersTheFileWhenItIsOpenedAgain) {
  openHalfWay("Unwanted.mp4");
  ASSERT_TRUE(tap("Cancel Unwanted.mp4"));
  ASSERT_TRUE(comes("Unwanted.mp4, Cancelled"));
  EXPECT_TRUE(comes("Retry Unwanted.mp4"));
  for (const auto& file : fs::directory_iterator(ofPhone(kFolder))) ADD_FAILURE() << file.path();
  thePhone().launchReceived(_share.token);
  EXPECT_TRUE(cellIs("Unwanted.mp4", "not downloaded"));
}

TEST_F(DownloadWindow, GivesSizesAsTheViewerDoes) {
  ASSERT_TRUE(selectFrom(thePhone().share({thePhone().makeFile("Sized.txt", 10000)})));
  ASSERT_TRUE(comes("Sized.txt, 9.8KB"));
  ASSERT_TRUE(tap("Sized.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(saysNow("Sized.txt downloaded"));
  open(kDownloads);
  EXPECT_TRUE(comes("Sized.txt, Downloaded, 9.8 KB"));
}

TEST_F(DownloadWindow, WaitsForWifiAndGoesOnWhenItComes) {
  thePhone()({"network", "cellular"});
  ask("Photo.bin", "1");
  open(kDownloads);
  ASSERT_TRUE(comes("Photo.bin, Waiting for Wi-Fi"));
  EXPECT_FALSE(fs::exists(stored("Photo.bin")));
  thePhone()({"network", "wifi"});
  EXPECT_TRUE(comes("Photo.bin, Downloaded"));
}

TEST_F(DownloadWindow, CancelsWhatWaits) {
  thePhone()({"network", "none"});
  ask("Photo.bin", "0");
  open(kDownloads);
  ASSERT_TRUE(tap("Cancel Photo.bin"));
  EXPECT_TRUE(comes("Photo.bin, Cancelled"));
  EXPECT_TRUE(fs::is_empty(ofPhone(kFolder)));
}

TEST_F(DownloadWindow, ShowsAFileInItsFolder) {
  ask("Shown.bin", "0");
  open(kDownloads);
  ASSERT_TRUE(tap("Show in folder Shown.bin"));
  EXPECT_TRUE(waitFor([] {
    return thePhone()
               .command(
                   {"shell", "xdotool", "search", "--onlyvisible", "--name", "^Downloads - Thunar"})
               .status == 0;
  }));
  thePhone()({"shell", "Thunar", "--quit"});
}

TEST_F(DownloadWindow, OpensTheShareFromTheNotification) {
  const Share share = thePhone().share({thePhone().makeFile("News.txt", 10)}, {"--single"});
  ASSERT_TRUE(selectFrom(share));
  ASSERT_TRUE(tap("News.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(saysNow("News.txt downloaded"));
  thePhone().closeViewer();
  thePhone()({"tap", "360,20"});
  EXPECT_TRUE(comes("News.txt, "));
  const std::string launch = thePhone()({"launches", "--all"});
  EXPECT_NE(launch.find(share.token, launch.rfind("contents_token")), std::string::npos) << launch;
  EXPECT_NE(launch.find("single_share", launch.rfind("contents_token")), std::string::npos);
}
