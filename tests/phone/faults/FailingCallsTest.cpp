// Every call that can fail fails once, at every place of the main ways: the platform's own calls,
// and malloc, open, write and connect below them. FAULTS=all tries each one, FAULTS=20-40 these;
// otherwise it is a few of them.

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <vector>

#include "Companions.h"
#include "Journey.h"
#include "ViewerSetting.h"

namespace fs = std::filesystem;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

/// Which of `count` calls FAULTS wants to fail.
std::vector<long> wanted(long count) {
  long first = 1, last = count;
  sscanf(getenv("FAULTS"), "%ld-%ld", &first, &last);
  std::vector<long> numbers;
  for (long n = first; n <= std::min(last, count); n++) numbers.push_back(n);
  return numbers;
}

bool isClean(int status) {
  constexpr int kEndedBySignal = 128 + 15;
  return status == EXIT_SUCCESS || status == EXIT_FAILURE || status == kEndedBySignal;
}

class FailingCalls : public testing::Test {
 protected:
  static void SetUpTestSuite() { _journey = std::make_unique<Journey>(); }
  static void TearDownTestSuite() { _journey.reset(); }

  void TearDown() override { thePhone().closeViewer(); }

  /// Goes all ways in that environment; the viewer has to stay sound, and the next one to work.
  void go(const Words& environment) {
    thePhone().closeViewer();
    const size_t logged = thePhone().log().size();
    ViewerSetting setting(environment);
    EXPECT_TRUE(_journey->go(_watch)) << "the viewer hangs";
    const bool ended = _watch.settle() == "gone";
    thePhone().closeViewer();
    EXPECT_TRUE(waitFor([&] { return !setting.endings().empty(); }));
    for (const int status : setting.endings()) EXPECT_TRUE(isClean(status)) << "status " << status;
    const std::string log = thePhone().log().substr(logged);
    const bool said = log.find("E/") != std::string::npos || log.find("F/") != std::string::npos;
    EXPECT_TRUE(said || !ended) << "the viewer went without a word";
    closePicker();
  }
  void expectGoodHealth() {
    thePhone().launchReceived(_journey->received().token);
    EXPECT_TRUE(comes("File 1.txt"));
  }

  /// Goes all ways while `variable` counts the calls; how many there were.
  long count(Words environment, const std::string& variable) {
    fs::remove(ViewerSetting::outside("calls"));
    environment.push_back(variable + "=" + ViewerSetting::inPhone("calls"));
    go(environment);
    std::ifstream file(ViewerSetting::outside("calls"));
    return std::count(std::istreambuf_iterator<char>(file), {}, '\n');
  }

  void closePicker() { thePhone().end({"contacts-picker", "ovuport"}); }

  /// Lets one call after the other fail: the usual ones, or those that FAULTS wants.
  void failEach(const Words& environment, const std::string& counter, const std::string& failing,
                std::vector<long> numbers) {
    if (getenv("FAULTS")) numbers = wanted(count(environment, counter));
    for (const long n : numbers) {
      SCOPED_TRACE("call " + std::to_string(n));
      Words harmed = environment;
      harmed.push_back(failing + "=" + std::to_string(n));
      EXPECT_GE(count(harmed, counter), n) << "there are not as many";
      expectGoodHealth();
    }
  }
  void failEachBelow(const char* what, const std::vector<long>& usual) {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer wants to be loaded first";
#endif
    failEach({kPreload, std::string("FAILING=") + what}, "FAILING_COUNT", "FAILING_AT", usual);
  }

  static constexpr const char* kPreload = "LD_PRELOAD=" FAILING_CALLS;
  static std::unique_ptr<Journey> _journey;
  LoopWatch _watch;
};

std::unique_ptr<Journey> FailingCalls::_journey;

}  // namespace

TEST_F(FailingCalls, OfThePlatformDoNoHarm) {
  failEach({}, "PLATFORM_COUNT_CALLS", "PLATFORM_FAIL_CALL", {20, 80});
}

TEST_F(FailingCalls, ToMallocDoNoHarm) {
  failEachBelow("malloc", {1});
}

TEST_F(FailingCalls, ToNewEndTheViewerWithAWord) {
  failEachBelow("new", {500});
}

TEST_F(FailingCalls, ToOpenDoNoHarm) {
  failEachBelow("open", {10});
}

TEST_F(FailingCalls, ToWriteDoNoHarm) {
  failEachBelow("write", {1});
}

TEST_F(FailingCalls, ToConnectDoNoHarm) {
  failEachBelow("connect", {2});
}
