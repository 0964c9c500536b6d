// What fifty launches leave behind in one process.

#include <gtest/gtest.h>

#include "Companions.h"
#include "Journey.h"

using phone::thePhone;

// The sanitizer judges when the process ends, in its log.
TEST(Leaks, AreNoneAfterFiftyLaunches) {
#ifndef __SANITIZE_ADDRESS__
  GTEST_SKIP() << "takes a build with the sanitizer: ./test --sanitize";
#endif
  constexpr int kLaunches = 50;
  const Journey journey;
  LoopWatch watch;
  for (int i = 0; i < kLaunches; i += 2) {
    thePhone().launchReceived(journey.received().token);
    ASSERT_EQ(watch.settle(), "answers");
    thePhone()({"tap", i % 4 ? place::kFirstCell : place::kBottomButton});
    ASSERT_EQ(watch.settle(), "answers");
    thePhone()({"launch", "sent", "--request", std::to_string(journey.sent().request)});
    ASSERT_EQ(watch.settle(), "answers");
  }
  ASSERT_TRUE(comes("Reshare"));
  thePhone().closeViewer();
  EXPECT_EQ(thePhone().sanitizerFindings(), "");
}
