#pragma once

#include <functional>

/// Runs the main loop until the condition holds; false when that takes longer than any test may.
bool waitUntil(const std::function<bool()>& condition);
/// Runs what is due on the main loop by now.
void runPending();
