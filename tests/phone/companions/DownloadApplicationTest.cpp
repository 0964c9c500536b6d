#include <filesystem>
#include <fstream>
#include <thread>

#include "Companions.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr const char* kFolder = "/opt/usr/media/Downloads";

class DownloadApplication : public testing::Test {
 protected:
  void TearDown() override {
    thePhone()({"service", "ok"});
    thePhone()({"network", "wifi"});
    thePhone().closeViewer();
    kill();
    for (const auto& entry : fs::directory_iterator(ofPhone(kFolder))) fs::remove_all(entry);
  }

  static void kill() {
    thePhone()({"shell", "sh", "-c",
                "p=$(pidof download-manager) || exit 0; kill -9 $p; "
                "while kill -0 $p 2>/dev/null; do sleep 0.02; done"});
  }

  static std::string serviceAddress() {
    const std::string status = thePhone()({"status"});
    const std::size_t begin = status.find("http://");
    return status.substr(begin, status.find('\n', begin) - begin);
  }

  static std::string address(const Share& share, int file) {
    return serviceAddress() + "/share/" + share.token + "/file/" + std::to_string(file);
  }

  static void ask(const std::string& url, const std::string& name, std::size_t size,
                  const char* wifiOnly = "0") {
    thePhone()({"launch", "raw", "view", "--app", kDownloads, "url[]=" + url, "name[]=" + name,
                "size[]=" + std::to_string(size), std::string("wifi_check=") + wifiOnly});
  }

  static std::string stored(const std::string& name) {
    return ofPhone(std::string(kFolder) + "/" + name);
  }

  static std::string index() {
    return contentOf(ofPhone("/opt/usr/apps/com.orlant.myfile-lite/shared/data/zelqo/zelqo.json"));
  }
};

}  // namespace

TEST_F(DownloadApplication, BringsTheSelectedFilesOfAShareAndTheViewerShowsIt) {
  Words files;
  for (int i = 1; i <= 5; i++) {
    files.push_back(thePhone().makeFile("Paper " + std::to_string(i) + ".txt", 5000u * i));
  }
  const Share share = thePhone().share(files);
  thePhone().launchReceived(share.token);
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(tap("Paper 2.txt"));
  ASSERT_TRUE(tap("Paper 4.txt"));
  ASSERT_TRUE(tap("Done"));
  EXPECT_TRUE(says("2 files downloaded"));
  EXPECT_EQ(contentOf(stored("Paper 2.txt")), contentOf(files[1]));
  EXPECT_EQ(contentOf(stored("Paper 4.txt")), contentOf(files[3]));
  EXPECT_EQ(std::distance(fs::directory_iterator(ofPhone(kFolder)), {}), 2);
  EXPECT_NE(index().find(address(share, 1)), std::string::npos);
  EXPECT_TRUE(waitFor([] {
    int downloaded = 0;
    for (const auto& item : thePhone().tree().items()) {
      downloaded += item.name.find(", downloaded") != std::string::npos;
    }
    return downloaded == 2;
  })) << thePhone().tree();
}

TEST_F(DownloadApplication, GoesOnWhereItWasKilled) {
  constexpr std::size_t kSize = 100'000'000;
  const std::string file = thePhone().makeFile("Long film.bin", 1000);
  fs::resize_file(file, kSize);
  const Share share = thePhone().share({file});
  open(kDownloads);
  ASSERT_TRUE(comes("Downloads"));
  std::thread killer([] {
    thePhone()({"shell", "sh", "-c",
                "p=$(pidof download-manager); cd /opt/usr/media/Downloads; "
                "until s=$(stat -c %s .*.part 2>/dev/null) && [ $s -gt 20000000 ]; do :; done; "
                "kill -9 $p"});
  });
  ask(address(share, 0), "Long film.bin", kSize);
  killer.join();
  ASSERT_FALSE(fs::exists(stored("Long film.bin")));
  open(kDownloads);
  ASSERT_TRUE(comes("Long film.bin, Downloaded"));
  EXPECT_EQ(contentOf(stored("Long film.bin")), contentOf(file));
}

TEST_F(DownloadApplication, OffersToTryAgainWhatFailed) {
  const std::string file = thePhone().makeFile("Letter.txt", 2000);
  const Share share = thePhone().share({file});
  const std::string url = address(share, 0);
  thePhone()({"service", "down"});
  ask(url, "Letter.txt", 2000);
  EXPECT_TRUE(says("Letter.txt could not be downloaded"));
  thePhone()({"service", "ok"});
  open(kDownloads);
  ASSERT_TRUE(tap("Retry Letter.txt"));
  EXPECT_TRUE(comes("Letter.txt, Downloaded"));
  EXPECT_EQ(contentOf(stored("Letter.txt")), contentOf(file));
}

TEST_F(DownloadApplication, WaitsForWifiAndGoesOnWhenItComes) {
  const Share share = thePhone().share({thePhone().makeFile("Photo.bin", 2000)});
  thePhone()({"network", "cellular"});
  ask(address(share, 0), "Photo.bin", 2000, "1");
  open(kDownloads);
  ASSERT_TRUE(comes("Photo.bin, Waiting for Wi-Fi"));
  EXPECT_FALSE(fs::exists(stored("Photo.bin")));
  thePhone()({"network", "wifi"});
  EXPECT_TRUE(comes("Photo.bin, Downloaded"));
}

TEST_F(DownloadApplication, CancelsWhatWaits) {
  const Share share = thePhone().share({thePhone().makeFile("Photo.bin", 2000)});
  thePhone()({"network", "none"});
  ask(address(share, 0), "Photo.bin", 2000);
  open(kDownloads);
  ASSERT_TRUE(tap("Cancel Photo.bin"));
  EXPECT_TRUE(comes("Photo.bin, Cancelled"));
  EXPECT_TRUE(fs::is_empty(ofPhone(kFolder)));
}

TEST_F(DownloadApplication, KeepsEveryNameInItsFolder) {
  const Share share = thePhone().share({thePhone().makeFile("x", 10)});
  ask(address(share, 0), "../../../../tmp/\n100%s%n\u202Egpj.exe", 10);
  open(kDownloads);
  ASSERT_TRUE(comes("_._.._.._.._tmp_100%s%ngpj.exe, Downloaded"));
  EXPECT_TRUE(fs::exists(stored("_._.._.._.._tmp_100%s%ngpj.exe")));
}

TEST_F(DownloadApplication, SaysThatARecalledShareIsGone) {
  ask(serviceAddress() + "/share/0000/file/0", "Gone.txt", 10);
  open(kDownloads);
  EXPECT_TRUE(comes("Gone.txt, No longer available"));
  EXPECT_TRUE(fs::is_empty(ofPhone(kFolder)));
}

TEST_F(DownloadApplication, OpensTheShareFromItsNotification) {
  const Share share = thePhone().share({thePhone().makeFile("News.txt", 10)});
  thePhone().launchReceived(share.token);
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(tap("News.txt"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(says("News.txt downloaded"));
  thePhone().closeViewer();
  thePhone()({"tap", "360,20"});
  EXPECT_TRUE(comes("News.txt, "));
  EXPECT_NE(thePhone()({"launches", "--all"}).rfind(share.token), std::string::npos);
}
