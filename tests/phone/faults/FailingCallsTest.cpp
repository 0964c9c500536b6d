// Every call that can fail fails once, at every place of the main ways: the platform's own calls,
// and malloc, open, write and connect below them. FAULTS=all tries each one, FAULTS=20-40 these;
// otherwise it is a few of them.

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <set>

#include "Companions.h"
#include "Journey.h"
#include "ViewerSetting.h"

namespace fs = std::filesystem;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

/// `few` numbers out of 1 to `count`, evenly spread, or those that the environment wants.
std::set<long> chosen(long count, long few) {
  std::set<long> numbers;
  const char* wanted = getenv("FAULTS");
  long first = 1, last = count;
  if (wanted && sscanf(wanted, "%ld-%ld", &first, &last) == 2) last = std::min(last, count);
  const bool all = wanted != nullptr;
  for (long n = first; all && n <= last; n++) numbers.insert(n);
  for (long i = 0; !all && i < few; i++) numbers.insert(1 + (2 * i + 1) * count / (2 * few));
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

  /// How many of them there are on the way.
  long count(const Words& environment, const std::string& record) {
    fs::remove(ViewerSetting::outside(record));
    go(environment);
    std::ifstream file(ViewerSetting::outside(record));
    return std::count(std::istreambuf_iterator<char>(file), {}, '\n');
  }

  void closePicker() { thePhone().end({"contacts-picker", "ovuport"}); }

  void failEach(const char* what, long few) {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer wants to be loaded first";
#endif
    const std::string failing = std::string("FAILING=") + what;
    const long all =
        count({kPreload, failing, "FAILING_COUNT=" + ViewerSetting::inPhone("calls")}, "calls");
    ASSERT_GT(all, 0);
    for (const long n : chosen(all, few)) {
      SCOPED_TRACE(std::string(what) + " " + std::to_string(n) + " of " + std::to_string(all));
      go({kPreload, failing, "FAILING_AT=" + std::to_string(n)});
      expectGoodHealth();
    }
  }

  static constexpr const char* kPreload = "LD_PRELOAD=" FAILING_CALLS;
  static std::unique_ptr<Journey> _journey;
  LoopWatch _watch;
};

std::unique_ptr<Journey> FailingCalls::_journey;

}  // namespace

TEST_F(FailingCalls, OfThePlatformDoNoHarm) {
  const long all = count({"PLATFORM_COUNT_CALLS=" + ViewerSetting::inPhone("calls")}, "calls");
  ASSERT_GT(all, 100);
  for (const long n : chosen(all, 3)) {
    SCOPED_TRACE("call " + std::to_string(n) + " of " + std::to_string(all));
    go({"PLATFORM_FAIL_CALL=" + std::to_string(n)});
    expectGoodHealth();
  }
}

TEST_F(FailingCalls, ToMallocDoNoHarm) {
  failEach("malloc", 1);
}

TEST_F(FailingCalls, ToNewEndTheViewerWithAWord) {
  failEach("new", 1);
}

TEST_F(FailingCalls, ToOpenDoNoHarm) {
  failEach("open", 1);
}

TEST_F(FailingCalls, ToWriteDoNoHarm) {
  failEach("write", 1);
}

TEST_F(FailingCalls, ToConnectDoNoHarm) {
  failEach("connect", 1);
}
