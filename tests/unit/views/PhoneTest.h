#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "fakes/FakeLog.h"
#include "fakes/FakePhone.h"

/// A test that starts with a working phone and an empty log.
class PhoneTest : public testing::Test {
 protected:
  PhoneTest() {
    FakePhone::get().reset();
    FakeLog::get().clear();
  }

  FakePhone& phone = FakePhone::get();
  FakeLog& log = FakeLog::get();
};
