#pragma once

#include <functional>

/// Runs the main loop until the condition holds; false when it does not in half a minute.
bool waitUntil(const std::function<bool()>& condition);
