/// What a user of a phone sees and does; everything waits for what it needs.
#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "User.h"

constexpr const char* kHistory = "com.orlant.zelqo-history";
constexpr const char* kSignUp = "com.orlant.ovuport";
constexpr const char* kPicker = "contacts-tabui-efl";

constexpr const char* kOwnNumber = "+821012345678";
constexpr const char* kSecondNumber = "+821099998888";
constexpr const char* kThirdNumber = "+821077776666";

/// Waits until the page shows that many cells.
testing::AssertionResult shows(const phone::Phone& phone, std::size_t cells);
/// Waits until the viewer has ended.
testing::AssertionResult viewerEnds(const phone::Phone& phone);

/// The lines that contain the text.
phone::Words linesWith(const phone::Phone& phone, const std::string& command,
                       const std::string& text);
void openApplication(const phone::Phone& phone, const char* application);
void openSent(const phone::Phone& phone, const phone::Share& share);

/// Another phone at the same sharing service.
std::unique_ptr<phone::Phone> secondPhone(const phone::Phone& first);
std::string serviceOf(const phone::Phone& phone);
/// The HTTP status of a file of a share.
unsigned statusOf(const phone::Phone& phone, const phone::Share& share, int file);

/// The phone as it was before the test, with the account on and no viewer.
class Sending : public testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  /// Waits for the viewer to log the text during this test.
  testing::AssertionResult logs(const std::string& text) const;

  static phone::Share send(const phone::Words& names, const std::string& to = kSecondNumber);

 private:
  std::size_t _loggedBefore = 0;
};
