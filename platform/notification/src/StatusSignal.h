/// How a status-bar message travels: a signal of the session bus, with the text.
#pragma once

namespace notification {

constexpr const char* kStatusBar = "phone.StatusBar1";
constexpr const char* kStatusBarPath = "/phone/StatusBar";
constexpr const char* kPosted = "MessagePosted";

}  // namespace notification
