// Downloads that break in the middle, and what the user can do then.

#include <filesystem>

#include "DownloadPage.h"
#include "Transfers.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

// Large against what waits in the buffers on the way when a connection breaks.
constexpr size_t kMegabytes = 64;
constexpr size_t kBytes = kMegabytes * kMegabyte;

class BrokenDownload : public DownloadPage {
 protected:
  static void download(const Share& share, const std::string& name) {
    ASSERT_TRUE(selectFrom(share));
    ASSERT_TRUE(tap(name));
    ASSERT_TRUE(titleIs("1 selected"));
    ASSERT_TRUE(tap("Done"));
  }

  /// Asked about because of its size.
  static void downloadLarge(const Share& share, const std::string& name) {
    download(share, name);
    ASSERT_TRUE(tapInPopup("Download"));
  }

  /// The download application can write no larger files from now on.
  static void limitFiles(const std::string& bytes) {
    thePhone()({"shell", "prlimit", "--fsize=" + bytes + ":",
                "--pid=" + thePhone().processesOf({"download-manager"})});
  }

  static bool isWhole(const std::string& name) {
    const std::string file = stored(name), source = thePhone().folder() + "/files/" + name;
    return fs::file_size(file) == fs::file_size(source) && contentOf(file) == contentOf(source);
  }
};

}  // namespace

TEST_F(BrokenDownload, GoesOnAfterItsApplicationWasKilled) {
  Gate gate(kBytes / 2);
  const Share share = gate.share("Long film.mp4", kMegabytes);
  const long sent = serviceCount("file_bytes");
  downloadLarge(share, "Long film.mp4");
  ASSERT_TRUE(gate.isReached());
  killDownloadApplication();
  gate.open();
  ASSERT_FALSE(fs::exists(stored("Long film.mp4")));
  open(kDownloads);
  ASSERT_TRUE(comes("Long film.mp4, Downloaded"));
  EXPECT_TRUE(isWhole("Long film.mp4"));
  EXPECT_EQ(filesIn(kFolder), 1u);
  const long all = serviceCount("file_bytes") - sent;
  EXPECT_GE(all, static_cast<long>(kBytes));
  EXPECT_LE(all, static_cast<long>(kBytes + kBytes / 10));
  thePhone()({"key", "Escape"});
  EXPECT_TRUE(cellIs("Long film.mp4", "downloaded"));
}

TEST_F(BrokenDownload, IsTriedAgainWhenTheServiceIsBack) {
  Gate gate(kBytes / 2);
  const Share share = gate.share("Broken film.mp4", kMegabytes);
  downloadLarge(share, "Broken film.mp4");
  ASSERT_TRUE(gate.isReached());
  thePhone()({"service", "down"});
  gate.open();
  EXPECT_TRUE(saysNow("Broken film.mp4 could not be downloaded"));
  EXPECT_FALSE(fs::exists(stored("Broken film.mp4")));
  open(kDownloads);
  ASSERT_TRUE(comes("Broken film.mp4, Connection lost"));
  thePhone()({"service", "ok"});
  ASSERT_TRUE(tap("Retry Broken film.mp4"));
  ASSERT_TRUE(comes("Broken film.mp4, Downloaded"));
  EXPECT_TRUE(isWhole("Broken film.mp4"));
  // The service counts from its new start: it was asked for the rest alone.
  EXPECT_LE(serviceCount("file_bytes"), static_cast<long>(kBytes / 2 + kBytes / 10));
}

TEST_F(BrokenDownload, SaysThatThePhoneIsFullAndGoesOnWhenThereIsRoom) {
  const std::string file = thePhone().makeFile("Heavy.bin", 3'000'000);
  const Share share = thePhone().share({file});
  open(kDownloads);
  ASSERT_TRUE(comes("Downloads"));
  limitFiles("1000000");
  download(share, "Heavy.bin");
  EXPECT_TRUE(saysNow("Heavy.bin could not be downloaded"));
  thePhone().launchReceived(share.token);
  EXPECT_TRUE(cellIs("Heavy.bin", "not downloaded"));
  EXPECT_FALSE(fs::exists(stored("Heavy.bin")));
  open(kDownloads);
  ASSERT_TRUE(comes("Heavy.bin, Not enough space on the phone"));
  limitFiles("unlimited");
  ASSERT_TRUE(tap("Retry Heavy.bin"));
  ASSERT_TRUE(comes("Heavy.bin, Downloaded"));
  EXPECT_EQ(contentOf(stored("Heavy.bin")), contentOf(file));
}

TEST_F(BrokenDownload, OfARecalledShareSaysSoAndCanBeTriedAgain) {
  const Share real = thePhone().shareTo("+821011112222", "+821012345678",
                                        {thePhone().makeFile("Regret.txt", 500)});
  thePhone()({"launch", "sent", "--request", std::to_string(real.request)});
  ASSERT_TRUE(tap("Recall"));
  ASSERT_TRUE(tap("OK"));
  ASSERT_TRUE(waitFor([] { return viewerProcess().empty(); }));
  const Share share = announced(R"([{"name":"Regret.txt","size":500,"type":"text/plain","url":")" +
                                addressOf(real, "file", 0) + R"("}])");
  download(share, "Regret.txt");
  EXPECT_TRUE(saysNow("Regret.txt could not be downloaded"));
  thePhone().launchReceived(share.token);
  EXPECT_TRUE(cellIs("Regret.txt", "not downloaded"));
  EXPECT_TRUE(fs::is_empty(ofPhone(kFolder)));
  open(kDownloads);
  EXPECT_TRUE(comes("Regret.txt, No longer available"));
  EXPECT_TRUE(comes("Retry Regret.txt"));
}

TEST_F(BrokenDownload, OfAFileThatIsShorterThanAnnouncedIsNotKept) {
  const Share real = thePhone().share({thePhone().makeFile("Short.txt", 500)});
  const Share share = announced(R"([{"name":"Short.txt","size":900,"type":"text/plain","url":")" +
                                addressOf(real, "file", 0) + R"("}])");
  download(share, "Short.txt");
  EXPECT_TRUE(saysNow("Short.txt could not be downloaded"));
  thePhone().launchReceived(share.token);
  EXPECT_TRUE(cellIs("Short.txt", "not downloaded"));
  EXPECT_FALSE(fs::exists(stored("Short.txt")));
  open(kDownloads);
  EXPECT_TRUE(comes("Short.txt, The file does not have the announced size"));
  EXPECT_TRUE(comes("Retry Short.txt"));
}

TEST_F(BrokenDownload, WithoutTheServiceLetsTheUserSelectAgainWhenTheShareIsOpened) {
  const std::string file = thePhone().makeFile("Patience.txt");
  const Share share = thePhone().share({file});
  thePhone()({"service", "down"});
  download(share, "Patience.txt");
  EXPECT_TRUE(saysNow("Patience.txt could not be downloaded"));
  thePhone().launchReceived(share.token);
  ASSERT_TRUE(cellIs("Patience.txt", "not downloaded"));
  thePhone()({"service", "ok"});
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(tap("Patience.txt"));
  ASSERT_TRUE(titleIs("1 selected"));
  ASSERT_TRUE(tap("Done"));
  EXPECT_TRUE(cellIs("Patience.txt", "downloaded"));
  EXPECT_EQ(contentOf(stored("Patience.txt")), contentOf(file));
}
