// Every call that can fail fails once, at every place of the main ways: the platform's own calls,
// and malloc, new, open, write and connect below them. FAULTS=all tries each one, FAULTS=20-40
// these, FAULTS=1-9000/100 every hundredth of these; otherwise it is a few of them.

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>
#include <vector>

#include "Companions.h"
#include "Journey.h"
#include "ViewerSetting.h"

namespace fs = std::filesystem;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr std::chrono::milliseconds kLongestWait{1000};

bool isClean(int status) {
  constexpr int kEndedBySignal = 128 + 15;
  return status == EXIT_SUCCESS || status == EXIT_FAILURE || status == kEndedBySignal;
}

/// Whether the viewer says why it does not go on. That a text has no thumbnails is no reason.
bool saysWhy(const std::string& log) {
  std::istringstream lines(log);
  for (std::string line; std::getline(lines, line);) {
    const bool isGrave = line.rfind("E/", 0) == 0 || line.rfind("F/", 0) == 0;
    if (isGrave && line.find("_readPictureUrls") == std::string::npos) return true;
  }
  return false;
}

/// The n-th call fails in this environment; `counter` names the file in which it is counted.
struct Fault {
  Words environment;
  std::string counter, failing;
  int ways;  ///< to go on, to see what the failure left behind

  Words at(const std::string& number) const {
    Words all = environment;
    all.push_back(counter + "=" + ViewerSetting::inPhone("calls"));
    if (!number.empty()) all.push_back(failing + "=" + number);
    return all;
  }
};

Fault below(const char* what) {
  return {{"LD_PRELOAD=" FAILING_CALLS, std::string("FAILING=") + what},
          "FAILING_COUNT",
          "FAILING_AT",
          0};
}

const Fault kOfThePlatform{{}, "PLATFORM_COUNT_CALLS", "PLATFORM_FAIL_CALL", 1};

class FailingCalls : public testing::Test {
 protected:
  void SetUp() override { thePhone().closeViewer(); }
  void TearDown() override { thePhone().closeViewer(); }

  /// Goes the ways in that environment, up to that on which the `last` call was made and `more`
  /// beyond it; the viewer has to stay sound, and to work afterwards. What was counted on the ways.
  Words go(const Words& environment, size_t last = SIZE_MAX, int more = 0) {
    fs::remove(ViewerSetting::outside("calls"));
    const Journey journey;
    ViewerSetting setting(environment);
    bool isEnough = false;
    const auto hasGoneFarEnough = [&] {
      isEnough = counted().size() >= last && more-- == 0;
      return isEnough;
    };
    _watch.begin();
    EXPECT_TRUE(journey.go(_watch, hasGoneFarEnough)) << "the viewer hangs";
    Words calls = counted();
    setting.lift();
    if (isEnough || !endsAfterRecall()) expectGoodHealth(journey);
    EXPECT_LE(_watch.longestWait().count(), kLongestWait.count());
    thePhone().end({"zelqo-viewer", "contacts-picker", "ovuport"});
    expectCleanEndings(setting);
    return calls;
  }
  /// A fault may stop the recall; the viewer then stays.
  bool endsAfterRecall() {
    return waitFor([&] { return _watch.settle() == "gone"; }, std::chrono::milliseconds(600));
  }
  void expectGoodHealth(const Journey& journey) {
    _watch.run(PROGRAMS "/phone-launch launch_viewer view_type=received contents_token=" +
               journey.received().token);
    EXPECT_TRUE(comes("File 1.txt"));
  }
  void expectCleanEndings(const ViewerSetting& setting) {
    EXPECT_TRUE(waitFor([&] { return !setting.endings().empty(); }));
    const std::string log = thePhone().log();
    const std::string news = log.substr(std::min(_logged, log.size()));
    _logged = log.size();
    for (const int status : setting.endings()) {
      EXPECT_TRUE(isClean(status)) << "status " << status;
      EXPECT_TRUE(status != EXIT_FAILURE || saysWhy(news)) << "the viewer went without a word";
    }
  }

  static Words counted() {
    std::ifstream file(ViewerSetting::outside("calls"));
    Words lines;
    for (std::string line; std::getline(file, line);) lines.push_back(line);
    return lines;
  }

  /// Lets the n-th call fail. False when there are not as many.
  bool fail(const Fault& fault, size_t n) {
    SCOPED_TRACE("call " + std::to_string(n));
    return go(fault.at(std::to_string(n)), n, fault.ways).size() >= n;
  }

  /// Lets one call after the other fail: the usual ones, or all that FAULTS wants, as many as there
  /// are.
  void failEach(const Fault& fault, const std::vector<size_t>& usual) {
    const char* wanted = getenv("FAULTS");
    if (!wanted) {
      for (const size_t n : usual) EXPECT_TRUE(fail(fault, n)) << "there are not as many";
      return;
    }
    size_t first = 1, last = SIZE_MAX, step = 1;
    sscanf(wanted, "%zu-%zu/%zu", &first, &last, &step);
    const size_t all = go(fault.at("")).size();
    size_t n = first;
    // The ways are not the same to the last call each time; the first writes what stays.
    while (n <= last && (fail(fault, n) || fail(fault, n))) n += step;
    std::cout << all << " calls; tried " << first << " to " << n - step << " by " << step << "\n";
    EXPECT_GT(n, std::min(last, all * 3 / 4)) << "the ways ended too early";
  }

  LoopWatch _watch;
  size_t _logged = thePhone().log().size();
};

class FailingCallsBelow : public FailingCalls {
 protected:
  void SetUp() override {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer wants to be loaded first";
#endif
    FailingCalls::SetUp();
  }
};

}  // namespace

TEST_F(FailingCalls, OfThePlatformDoNoHarm) {
  failEach(kOfThePlatform, {20, 80});
}

TEST_F(FailingCallsBelow, ToMallocDoNoHarm) {
  failEach(below("malloc"), {1});
}

// Each ends the process on the spot, which takes no journey of its own; FAULTS adds real endings.
TEST_F(FailingCallsBelow, ToNewEndTheViewerWithAWord) {
  const Words endings = go(below("new").at("each"));
  EXPECT_GT(endings.size(), 1000u);
  for (size_t i = 0; i < endings.size(); i++) {
    EXPECT_EQ(endings[i], std::to_string(EXIT_FAILURE)) << "call " << i + 1;
  }
  failEach(below("new"), {});
}

TEST_F(FailingCallsBelow, ToOpenDoNoHarm) {
  failEach(below("open"), {10});
}

TEST_F(FailingCallsBelow, ToWriteDoNoHarm) {
  failEach(below("write"), {1});
}

TEST_F(FailingCallsBelow, ToConnectDoNoHarm) {
  failEach(below("connect"), {2});
}
