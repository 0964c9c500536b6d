// A phone on which something is missing or wrong: room on the disk, folders that can be written,
// files of the installation, the network's manager, the time of day.

#include <common/Database.h>

#include <cstdint>
#include <filesystem>
#include <fstream>

#include "Companions.h"
#include "Journey.h"
#include "Neighbour.h"
#include "ViewerSetting.h"

namespace fs = std::filesystem;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr const char* kApplication = "apps/com.orlant.zelqo";
constexpr const char* kPreload = "LD_PRELOAD=" FAILING_CALLS;

class BadWorld : public testing::Test {
 protected:
  void SetUp() override { thePhone().closeViewer(); }
  void TearDown() override {
    thePhone().closeViewer();
    thePhone().end({"contacts-picker", "download-manager"});
  }

  /// All ways are gone in this world without a hang or a crash.
  void expectSoundness(const Words& environment = {}) {
    ViewerSetting setting(environment);
    EXPECT_TRUE(_journey.go(_watch)) << "the viewer hangs";
    thePhone().closeViewer();
    ASSERT_TRUE(waitFor([&] { return !setting.endings().empty(); }));
    for (const int status : setting.endings()) EXPECT_TRUE(status == 0 || status == 1) << status;
  }
  void expectHealth() const {
    thePhone().closeViewer();
    thePhone().launchReceived(_journey.received().token);
    EXPECT_TRUE(comes("File 1.txt"));
    EXPECT_TRUE(waitFor([] { return thePhone().tree().enables("Download"); }));
  }

  LoopWatch _watch;
  const Journey _journey;
};

/// A file or folder of the phone that is away as long as this object lives.
class Missing {
 public:
  explicit Missing(const std::string& name)
      : _path(ViewerSetting::outside(name)), _aside(_path.string() + ".aside") {
    fs::rename(_path, _aside);
  }
  ~Missing() {
    fs::remove_all(_path);
    fs::rename(_aside, _path);
  }

 private:
  const fs::path _path, _aside;
};

/// Stores of the phone in which somebody began to write and never ends, as long as this object
/// lives.
class Locked {
 public:
  explicit Locked(const std::string& folder) {
    for (const auto& file : fs::directory_iterator(ViewerSetting::outside(folder))) {
      if (file.path().extension() != ".db") continue;
      _stores.push_back(common::Database::open(file.path(), ""));
      EXPECT_TRUE(_stores.back()->execute("BEGIN IMMEDIATE")) << file.path();
    }
    EXPECT_FALSE(_stores.empty());
  }

 private:
  std::vector<std::unique_ptr<common::Database>> _stores;
};

/// The time of day as the viewer sees it.
class Clock {
 public:
  Clock() { set(0); }
  ~Clock() { fs::remove(path()); }

  void set(int64_t wrongBySeconds) const {
    std::fstream file(path(), std::ios::binary | std::ios::in | std::ios::out);
    if (!file) file.open(path(), std::ios::binary | std::ios::out);
    file.write(reinterpret_cast<const char*>(&wrongBySeconds), sizeof wrongBySeconds);
  }
  static Words environment() {
    return {kPreload, "FAILING_CLOCK=" + ViewerSetting::inPhone("clock")};
  }

 private:
  static std::string path() { return ViewerSetting::outside("clock"); }
};

class Preloaded : public BadWorld {
 protected:
  void SetUp() override {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer wants to be loaded first";
#endif
    BadWorld::SetUp();
  }
};

}  // namespace

TEST_F(Preloaded, FullDiskDoesNoHarm) {
  expectSoundness({kPreload, "FAILING=write", "FAILING_AT=1", "FAILING_ON=1"});
  expectHealth();
}

TEST_F(Preloaded, FoldersThatCannotBeWrittenDoNoHarm) {
  expectSoundness({kPreload, "FAILING=store", "FAILING_AT=1", "FAILING_ON=1"});
  expectHealth();
}

TEST_F(Preloaded, ClockThatJumpsMakesTheShareExpireAndBack) {
  constexpr int64_t kYear = int64_t{365} * 24 * 3600;
  const Clock clock;
  const ViewerSetting setting(Clock::environment());
  thePhone().launchReceived(_journey.received().token);
  ASSERT_TRUE(comes("File 1.txt"));
  clock.set(kYear);
  thePhone()({"tap", place::kFirstCell});
  EXPECT_EQ(_watch.settle(), "answers");
  thePhone().launchReceived(_journey.received().token);
  EXPECT_TRUE(goes("File 1.txt"));
  EXPECT_TRUE(comes("Back"));
  clock.set(-kYear);
  thePhone().launchReceived(_journey.received().token);
  EXPECT_TRUE(comes("File 1.txt"));
  clock.set(0);
  expectHealth();
}

TEST_F(BadWorld, MissingThemeOfTheDeviceIsSaidAndDoesNoHarm) {
  {
    const Missing theme("share/theme/device.edj");
    expectSoundness();
    EXPECT_NE(thePhone().log().find("no device theme in"), std::string::npos);
  }
  expectHealth();
}

TEST_F(BadWorld, MissingThemeOfTheViewerDoesNoHarm) {
  {
    const Missing theme(std::string(kApplication) + "/res/edje/remote_share_viewer.edj");
    expectSoundness();
  }
  expectHealth();
}

TEST_F(BadWorld, MissingCatalogueLeavesTheNamesOfTheTexts) {
  {
    const Missing catalogue(std::string(kApplication) + "/res/locale");
    thePhone().launchReceived(_journey.received().token);
    EXPECT_TRUE(comes("IDS_RSH_BUTTON_DOWNLOAD_ABB3"));
    thePhone().closeViewer();
    expectSoundness();
  }
  expectHealth();
}

TEST_F(BadWorld, MissingTablesDoNoHarm) {
  {
    const Missing tables(std::string(kApplication) + "/shared/res/tables");
    expectSoundness();
  }
  expectHealth();
}

TEST_F(BadWorld, StoresThatAreLockedForeverHoldNobodyUpForASecond) {
  ASSERT_TRUE(_journey.go(_watch));  // makes them
  thePhone().closeViewer();
  {
    const Locked stores("dbspace"), preferences(std::string(kApplication) + "/data");
    _watch.begin();
    expectSoundness();
    EXPECT_LE(_watch.longestWait().count(), 1000);
  }
  expectHealth();
}

TEST_F(BadWorld, MissingNetworkManagerLeavesTheKernelsWord) {
  {
    const Harmed world(neighbour::kWorld, Harm::Kill);
    expectSoundness();
  }
  expectHealth();
}
