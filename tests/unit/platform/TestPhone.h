/// A phone of the test program's own: a private bus, which is both session and system bus, and a
/// private folder in place of /opt/usr.
#pragma once

#include <base/Bus.h>
#include <gtest/gtest.h>

#include <string>

#include "WaitUntil.h"

class TestPhone : public testing::Environment {
 public:
  static constexpr const char* kAppId = "test.self";

  TestPhone();
  void SetUp() override;
  void TearDown() override;

  /// "…" in place of "/opt/usr".
  static std::string root();
  /// Makes the bus start `command` for an application.
  static void install(const std::string& appId, const std::string& command);

  /// The process of the bus.
  static GPid bus();
  /// Ends the bus and starts another one in its place.
  static void replaceBus();
};

/// Runs the main loop until everything sent so far on the shared bus has been dealt with.
void settle();
/// A connection of its own, as another process would have.
common::OwnedBus otherConnection();

std::string readFile(const std::string& path);
void writeFile(const std::string& path, const std::string& contents);

/// Gives the text and frees it; "(null)" for null.
std::string take(char* text);
