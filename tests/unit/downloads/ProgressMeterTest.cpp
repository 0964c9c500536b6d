#include "ProgressMeter.h"

#include <gtest/gtest.h>

using downloads::ProgressMeter;

TEST(ProgressMeter, KnowsNothingBeforeASecondSample) {
  ProgressMeter meter;
  EXPECT_FALSE(meter.secondsFor(100));
  meter.sample(0, 0);
  EXPECT_FALSE(meter.secondsFor(100));
}

TEST(ProgressMeter, DerivesTheTimeLeftFromTheSpeed) {
  ProgressMeter meter;
  meter.sample(0, 0);
  meter.sample(1000, 1);
  EXPECT_DOUBLE_EQ(meter.secondsFor(5000).value(), 5.0);
}

TEST(ProgressMeter, CountsOnlyWhatArrivedWhileItWatched) {
  ProgressMeter meter;
  meter.sample(1000000, 10);
  meter.sample(1000100, 11);
  EXPECT_DOUBLE_EQ(meter.secondsFor(100).value(), 1.0);
}

TEST(ProgressMeter, SmoothsASuddenStall) {
  ProgressMeter meter;
  meter.sample(0, 0);
  meter.sample(1000, 1);
  meter.sample(1000, 2);
  EXPECT_NEAR(meter.secondsFor(700).value(), 1.0, 1e-9);
}

TEST(ProgressMeter, StartsAnewWhenTheCountFallsBack) {
  ProgressMeter meter;
  meter.sample(0, 0);
  meter.sample(1000, 1);
  meter.sample(10, 2);
  EXPECT_FALSE(meter.secondsFor(100));
}
