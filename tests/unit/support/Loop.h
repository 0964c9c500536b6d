#pragma once

#include <functional>

/// Runs the main loop until the condition holds; false when it does not for too long.
bool waitUntil(const std::function<bool()>& condition);
