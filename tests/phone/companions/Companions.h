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
/// As in User.h, on the one phone.
testing::AssertionResult comes(const std::string& name);
testing::AssertionResult goes(const std::string& name);
testing::AssertionResult tap(const std::string& name);
testing::AssertionResult says(const std::string& text);

std::string contentOf(const std::string& path);
/// A path under /opt/usr as this program sees it.
std::string ofPhone(const std::string& path);
