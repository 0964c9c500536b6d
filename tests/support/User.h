/// What a user of a phone sees and does; everything waits for what it needs.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "Phone.h"

namespace phone {

/// False says what is wrong, and what is on screen.
testing::AssertionResult seen(const Phone& phone, bool came, const std::string& wrong);

/// Waits for a widget whose name begins so; false, with what is on screen, when it never comes.
testing::AssertionResult comes(const Phone& phone, const std::string& name);
testing::AssertionResult goes(const Phone& phone, const std::string& name);
/// Waits for an enabled button or item whose name begins so, and taps it.
testing::AssertionResult tap(const Phone& phone, const std::string& name);
/// Waits for a status-bar message that contains the text.
testing::AssertionResult says(const Phone& phone, const std::string& text);

/// "X,Y", as the phone's commands take it.
std::string centreOf(const Widget& widget);

}  // namespace phone
