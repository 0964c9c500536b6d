#include "DownloadManager.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <memory>

#include "PartFile.h"
#include "TestFolder.h"
#include "TestServer.h"

using namespace downloads;

namespace {

std::string bytes(std::size_t count) {
  std::string content(count, '\0');
  for (std::size_t i = 0; i < count; i++) content[i] = static_cast<char>(i * 31 + i / 251);
  return content;
}

// How many bytes may wait for a socket's reader; 0 when the file is no socket.
int bufferOf(int file) {
  int bytes = 0;
  socklen_t size = sizeof bytes;
  return getsockopt(file, SOL_SOCKET, SO_RCVBUF, &bytes, &size) == 0 ? bytes : 0;
}

// The most of any socket of this process.
int largestBuffer() {
  int largest = 0;
  for (const auto& file : std::filesystem::directory_iterator("/proc/self/fd")) {
    largest = std::max(largest, bufferOf(std::stoi(file.path().filename())));
  }
  return largest;
}

// What the system makes of a wish.
int bufferFor(int bytes) {
  const int file = socket(AF_INET, SOCK_STREAM, 0);
  setsockopt(file, SOL_SOCKET, SO_RCVBUF, &bytes, sizeof bytes);
  const int given = bufferOf(file);
  close(file);
  return given;
}

class Recorder : public DownloadManager::Observer {
 public:
  void onStarted(const Download& download) override { events += "started " + download.name + ";"; }
  void onDone(const Download& download) override { events += "done " + download.name + ";"; }
  void onFailed(const Download& download) override { events += "failed " + download.name + ";"; }
  void onCancelled(const Download& download) override {
    events += "cancelled " + download.name + ";";
  }
  void onChanged(const Download& download) override {
    received = download.received;
    buffered = std::max(buffered, largestBuffer());
  }
  void onListChanged() override {}

  std::string events;
  std::uint64_t received = 0;
  int buffered = 0;
};

class Manager : public testing::Test {
 protected:
  Manager() { restart(); }

  // As after a kill: nothing of the running manager is kept but what is on disk.
  void restart() {
    manager.reset();
    manager = std::make_unique<DownloadManager>(
        DownloadManager::Folders{folder / "files", folder / "queue.db", folder / "index.json"},
        recorder);
  }

  static Download wanted(const std::string& url, const std::string& name, std::uint64_t size = 0) {
    Download download;
    download.url = url;
    download.name = name;
    download.size = size;
    download.token = "token";
    return download;
  }

  void fetch(const std::string& path, const std::string& name, std::uint64_t size = 0) {
    manager->setNetwork(Network::Wifi);
    manager->add({wanted(server.url(path), name, size)});
  }

  const Download& last() { return *manager->list().back(); }

  bool waitForEnd() {
    return waitUntil([this] { return !manager->hasPending(); });
  }

  void expectFailure(const std::string& path, std::uint64_t size, Failure failure) {
    fetch(path, "a.bin", size);
    ASSERT_TRUE(waitForEnd());
    EXPECT_EQ(last().state, State::Failed);
    EXPECT_EQ(last().failure, failure);
    EXPECT_EQ(recorder.events, "started a.bin;failed a.bin;");
    EXPECT_EQ(folder.names("files").find("a.bin"), std::string::npos);
  }

  TestFolder folder;
  TestServer server;
  Recorder recorder;
  std::unique_ptr<DownloadManager> manager;
};

}  // namespace

TEST_F(Manager, StoresAFileUnderItsNameAndInTheIndex) {
  server["/1"].body = bytes(300000);
  fetch("/1", "a.bin", 300000);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(recorder.events, "started a.bin;done a.bin;");
  EXPECT_EQ(last().path, folder / "files/a.bin");
  EXPECT_EQ(TestFolder::read(last().path), server["/1"].body);
  EXPECT_EQ(SharedIndex(folder / "index.json").find(server.url("/1")).value(), last().path);
  EXPECT_EQ(folder.names("files"), "a.bin");
}

TEST_F(Manager, KeepsTwoFilesOfOneNameApart) {
  server["/1"].body = "first";
  server["/2"].body = "second";
  manager->setNetwork(Network::Wifi);
  manager->add({wanted(server.url("/1"), "a.txt"), wanted(server.url("/2"), "a.txt")});
  ASSERT_TRUE(waitForEnd());
  const SharedIndex index(folder / "index.json");
  EXPECT_EQ(TestFolder::read(index.find(server.url("/1")).value()), "first");
  EXPECT_EQ(TestFolder::read(index.find(server.url("/2")).value()), "second");
  EXPECT_EQ(folder.names("files"), "a (1).txt a.txt");
}

TEST_F(Manager, ReplacesTheFileWhenTheSameAddressIsAskedForAgain) {
  server["/1"].body = "old";
  fetch("/1", "a.txt");
  ASSERT_TRUE(waitForEnd());
  server["/1"].body = "new";
  server["/1"].etag = "\"v2\"";
  fetch("/1", "a.txt");
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(manager->list().size(), 1u);
  EXPECT_EQ(folder.names("files"), "a.txt");
  EXPECT_EQ(TestFolder::read(folder / "files/a.txt"), "new");
}

TEST_F(Manager, NeverWritesOutsideItsFolderWhateverTheName) {
  server["/1"].body = "x";
  fetch("/1", "../../escaped");
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(folder.names("files"), "_._.._escaped");
}

TEST_F(Manager, StoresAnEmptyFile) {
  server["/1"].body = "";
  fetch("/1", "empty.txt");
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(last().state, State::Done);
  EXPECT_EQ(folder.names("files"), "empty.txt");
}

TEST_F(Manager, SaysThatARecalledShareIsGone) {
  server["/1"].status = 410;
  expectFailure("/1", 0, Failure::Gone);
}

TEST_F(Manager, SaysThatAnUnknownFileIsGone) {
  server["/1"].status = 404;
  expectFailure("/1", 0, Failure::Gone);
}

TEST_F(Manager, SaysThatTheServiceRefused) {
  server["/1"].status = 500;
  expectFailure("/1", 0, Failure::Refused);
}

TEST_F(Manager, TrustsNoServiceThatNobodyVouchesFor) {
  TestServer secure(folder.path());
  ASSERT_EQ(secure.url("").substr(0, 8), "https://");
  secure["/1"].body = "from somebody else";
  manager->setNetwork(Network::Wifi);
  manager->add({wanted(secure.url("/1"), "a.bin")});
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(last().failure, Failure::Network);
  EXPECT_EQ(secure.requests(), 0);
}

TEST_F(Manager, GivesUpARedirectLoop) {
  server["/1"].location = "/2";
  server["/2"].location = "/1";
  expectFailure("/1", 0, Failure::Refused);
}

TEST_F(Manager, FollowsARedirect) {
  server["/1"].location = "/2";
  server["/2"].body = "there";
  fetch("/1", "a.txt");
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(TestFolder::read(folder / "files/a.txt"), "there");
}

TEST_F(Manager, RefusesABodyLongerThanAnnounced) {
  server["/1"].body = bytes(1001);
  expectFailure("/1", 1000, Failure::WrongSize);
}

TEST_F(Manager, RefusesABodyLongerThanAnnouncedEvenWithoutALength) {
  server["/1"].body = bytes(1001);
  server["/1"].isChunked = true;
  expectFailure("/1", 1000, Failure::WrongSize);
}

TEST_F(Manager, RefusesABodyShorterThanAnnounced) {
  server["/1"].body = bytes(999);
  expectFailure("/1", 1000, Failure::WrongSize);
}

TEST_F(Manager, GivesUpWhenNothingArrivesForTooLong) {
  server["/1"].body = bytes(100000);
  server["/1"].isStuck = true;
  manager->setSilence(50);
  expectFailure("/1", 100000, Failure::Silent);
}

TEST_F(Manager, SaysThatThereIsNoService) {
  const std::string url = TestServer().url("/1");
  manager->setNetwork(Network::Wifi);
  manager->add({wanted(url, "a.bin")});
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(last().failure, Failure::Network);
}

TEST_F(Manager, AsksNobodyForWhatIsNoAddressOfTheWeb) {
  for (const char* url : {"", "file:///etc/passwd", "ftp://host/a", "http://", "not an address"}) {
    restart();
    manager->setNetwork(Network::Wifi);
    manager->add({wanted(url, "a.bin")});
    EXPECT_EQ(last().failure, Failure::Address) << url;
  }
}

TEST_F(Manager, SaysThatTheDiskIsFull) {
  server["/1"].body = bytes(300000);
  signal(SIGXFSZ, SIG_IGN);
  rlimit before{};
  getrlimit(RLIMIT_FSIZE, &before);
  rlimit limit = before;
  limit.rlim_cur = 200000;
  setrlimit(RLIMIT_FSIZE, &limit);
  fetch("/1", "a.bin", 300000);
  const bool ended = waitForEnd();
  setrlimit(RLIMIT_FSIZE, &before);
  ASSERT_TRUE(ended);
  EXPECT_EQ(last().failure, Failure::DiskFull);
  manager->retry(last().id);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(TestFolder::read(folder / "files/a.bin"), server["/1"].body);
}

TEST_F(Manager, GoesOnWhereTheLineBrokeWhenItIsTriedAgain) {
  server["/1"].body = bytes(1000000);
  server["/1"].isCutOff = true;
  fetch("/1", "a.bin", 1000000);
  ASSERT_TRUE(waitForEnd());
  ASSERT_EQ(last().state, State::Failed);
  EXPECT_EQ(last().failure, Failure::Network);
  server["/1"].isCutOff = false;
  manager->retry(last().id);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(server.lastRange(), "bytes=500000-");
  EXPECT_EQ(TestFolder::read(folder / "files/a.bin"), server["/1"].body);
  EXPECT_LE(server.bytesServed(), 1100000u);
}

TEST_F(Manager, GoesOnByItselfAfterItWasKilled) {
  server["/1"].body = bytes(1000000);
  server["/1"].isStuck = true;
  fetch("/1", "a.bin", 1000000);
  ASSERT_TRUE(waitUntil([this] { return recorder.received >= 500000; }));
  restart();
  server["/1"].isStuck = false;
  EXPECT_EQ(last().received, 500000u);
  manager->setNetwork(Network::Wifi);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(server.lastRange(), "bytes=500000-");
  EXPECT_EQ(TestFolder::read(folder / "files/a.bin"), server["/1"].body);
}

TEST_F(Manager, LeavesLittleOfAFileInBuffersWhereAKillWouldLoseIt) {
  server["/1"].body = bytes(1000000);
  fetch("/1", "a.bin", 1000000);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(recorder.buffered, bufferFor(1024 * 1024));
}

TEST_F(Manager, StartsOverWhenTheServiceHasAnotherFileNow) {
  server["/1"].body = bytes(100000);
  server["/1"].isCutOff = true;
  fetch("/1", "a.bin", 100000);
  ASSERT_TRUE(waitForEnd());
  server["/1"].isCutOff = false;
  server["/1"].body = std::string(100000, 'n');
  server["/1"].etag = "\"v2\"";
  manager->retry(last().id);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(TestFolder::read(folder / "files/a.bin"), server["/1"].body);
}

TEST_F(Manager, StartsOverWithoutATagToCompareBy) {
  server["/1"].body = bytes(100000);
  server["/1"].etag = "";
  server["/1"].isCutOff = true;
  fetch("/1", "a.bin", 100000);
  ASSERT_TRUE(waitForEnd());
  server["/1"].isCutOff = false;
  manager->retry(last().id);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(server.lastRange(), "");
  EXPECT_EQ(TestFolder::read(folder / "files/a.bin"), server["/1"].body);
}

TEST_F(Manager, FinishesAFileThatWasWholeWhenItWasKilled) {
  server["/1"].body = bytes(1000);
  server["/1"].isStuck = true;
  fetch("/1", "a.bin", 1000);
  ASSERT_TRUE(waitUntil([this] { return recorder.received == 500; }));
  manager.reset();
  TestFolder parts;
  const std::string part = PartFile::pathFor(folder / "files", server.url("/1"));
  folder.write(part.substr(folder.path().size() + 1), server["/1"].body);
  const int requests = server.requests();
  restart();
  manager->setNetwork(Network::Wifi);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(server.requests(), requests);
  EXPECT_EQ(TestFolder::read(folder / "files/a.bin"), server["/1"].body);
}

TEST_F(Manager, WaitsForWifiWhenItIsAskedTo) {
  server["/1"].body = "x";
  Download download = wanted(server.url("/1"), "a.txt");
  download.wifiOnly = true;
  manager->setNetwork(Network::Other);
  manager->add({download});
  EXPECT_TRUE(manager->isHeldBack(last()));
  EXPECT_EQ(recorder.events, "");
  manager->setNetwork(Network::Wifi);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(recorder.events, "started a.txt;done a.txt;");
}

TEST_F(Manager, HoldsARunningDownloadWhenTheWifiGoesAndGoesOnWhenItComes) {
  server["/1"].body = bytes(100000);
  server["/1"].isStuck = true;
  Download download = wanted(server.url("/1"), "a.bin", 100000);
  download.wifiOnly = true;
  manager->setNetwork(Network::Wifi);
  manager->add({download});
  ASSERT_TRUE(waitUntil([this] { return recorder.received == 50000; }));
  manager->setNetwork(Network::Other);
  EXPECT_TRUE(manager->isHeldBack(last()));
  server["/1"].isStuck = false;
  manager->setNetwork(Network::Wifi);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(server.lastRange(), "bytes=50000-");
  EXPECT_EQ(last().state, State::Done);
}

TEST_F(Manager, RunsThreeAtATime) {
  std::vector<Download> all;
  for (int i = 0; i < 5; i++) {
    const std::string path = "/" + std::to_string(i);
    server[path].body = bytes(1000);
    server[path].isStuck = true;
    all.push_back(wanted(server.url(path), "f" + std::to_string(i)));
  }
  manager->setNetwork(Network::Wifi);
  manager->add(all);
  EXPECT_EQ(recorder.events, "started f0;started f1;started f2;");
  manager->cancel(manager->list().front()->id);
  EXPECT_EQ(recorder.events, "started f0;started f1;started f2;cancelled f0;started f3;");
}

TEST_F(Manager, LeavesNothingBehindWhenItIsCancelled) {
  server["/1"].body = bytes(100000);
  server["/1"].isStuck = true;
  fetch("/1", "a.bin", 100000);
  ASSERT_TRUE(waitUntil([this] { return recorder.received == 50000; }));
  manager->cancel(last().id);
  EXPECT_EQ(last().state, State::Cancelled);
  EXPECT_EQ(folder.names("files"), "");
  restart();
  manager->setNetwork(Network::Wifi);
  EXPECT_EQ(last().state, State::Cancelled);
}

TEST_F(Manager, DownloadsAnAddressThatIsRunningOnlyOnce) {
  server["/1"].body = bytes(1000);
  fetch("/1", "a.bin", 1000);
  fetch("/1", "a.bin", 1000);
  ASSERT_TRUE(waitForEnd());
  EXPECT_EQ(server.requests(), 1);
  EXPECT_EQ(manager->list().size(), 1u);
}

TEST_F(Manager, ForgetsOnlyWhatHasEnded) {
  server["/1"].body = "x";
  server["/2"].body = bytes(1000);
  server["/2"].isStuck = true;
  fetch("/1", "a.txt");
  ASSERT_TRUE(waitForEnd());
  fetch("/2", "b.txt");
  manager->forgetEnded();
  ASSERT_EQ(manager->list().size(), 1u);
  EXPECT_EQ(last().name, "b.txt");
  EXPECT_NE(folder.names("files").find("a.txt"), std::string::npos);
}
