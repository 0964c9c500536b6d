#include "ZQVTimer.h"

#include <Ecore.h>
#include <gtest/gtest.h>

#include <memory>

namespace {

constexpr double kSoon = 0.001;

/// Runs the loop until `done` is true; the watchdog of the test runner ends what never comes.
template <typename Done>
void runUntil(Done done) {
  while (!done()) ecore_main_loop_iterate();
}

}  // namespace

TEST(Timer, TicksUntilItsTickHasEnough) {
  ZQVTimer timer;
  int ticks = 0;
  timer.start(kSoon, [&] { return ++ticks < 3; });
  runUntil([&] { return !timer.isRunning(); });
  EXPECT_EQ(ticks, 3);
}

TEST(Timer, ForgetsWhatItWaitedForWhenStartedAgain) {
  ZQVTimer timer;
  bool first = false;
  bool second = false;
  timer.start(kSoon, [&] { return !(first = true); });
  timer.start(kSoon, [&] { return !(second = true); });
  runUntil([&] { return second; });
  EXPECT_FALSE(first);
}

TEST(Timer, MayBeStartedAnewByItsTick) {
  ZQVTimer timer;
  bool second = false;
  timer.start(kSoon, [&] {
    timer.start(kSoon, [&] { return !(second = true); });
    return false;
  });
  runUntil([&] { return second; });
  EXPECT_FALSE(timer.isRunning());
}

TEST(Timer, MayBeDestroyedByItsTick) {
  auto timer = std::make_unique<ZQVTimer>();
  timer->start(kSoon, [&] {
    timer.reset();
    return false;
  });
  runUntil([&] { return !timer; });
}

int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  ecore_init();
  const int result = RUN_ALL_TESTS();
  ecore_shutdown();
  return result;
}
