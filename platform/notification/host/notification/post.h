/// Ordinary notifications: shown for five seconds, or until they are opened or dismissed.
#pragma once

#include <functional>
#include <string>

namespace notification {

/// Shows `text` as it stands. `onOpen` runs on the main loop when the user taps it. False when
/// there is nothing to show or no session bus.
bool post(const std::string& text, std::function<void()> onOpen);

}  // namespace notification
