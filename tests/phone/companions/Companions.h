/// What the tests of the phone's own applications have in common.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "Phone.h"

constexpr const char* kDownloads = "com.orlant.myfile-download-manager";
constexpr const char* kHistory = "com.orlant.zelqo-history";
constexpr const char* kSignUp = "com.orlant.ovuport";
constexpr const char* kPicker = "contacts-tabui-efl";

/// Opens an application's start page.
void open(const char* application);
/// Waits for a widget whose name begins so; false, with what is on screen, when it never comes.
testing::AssertionResult comes(const std::string& name);
testing::AssertionResult goes(const std::string& name);
/// Waits for it and taps it.
testing::AssertionResult tap(const std::string& name);
/// Waits for a status-bar message that contains the text.
testing::AssertionResult says(const std::string& text);

std::string contentOf(const std::string& path);
/// A path under /opt/usr as this program sees it.
std::string ofPhone(const std::string& path);
