#pragma once

#include <glib.h>
#include <gtest/gtest.h>

#include <string>

#include "FakeLog.h"
#include "FakePhone.h"
#include "FakePlatform.h"
#include "FakeTimer.h"

using Errors = std::vector<std::string>;

/// Every test begins with an empty log and a phone on which everything works.
class ViewerTest : public testing::Test {
 protected:
  void SetUp() override {
    // What the test before has started may run out.
    FakeClock::advance(60);
    FakeLog::get().clear();
    FakePhone::get().reset();
    FakePlatform::get().reset();
  }

  static FakePlatform& platform() { return FakePlatform::get(); }
  static FakePhone& phone() { return FakePhone::get(); }
  static Errors errors() { return FakeLog::get().errors(); }
  static std::vector<std::string> traces() { return FakeLog::get().traces(); }
};

/// A text that the viewer hands out, as a string; "(null)" for null.
inline std::string taken(char* text) {
  std::string copy = text ? text : "(null)";
  g_free(text);
  return copy;
}
