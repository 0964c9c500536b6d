#pragma once

/// The argument that makes the test program send one history signal and end at once.
constexpr const char* kSendAndEnd = "--send-history-signal-and-end";

[[noreturn]] void sendHistorySignalAndEnd();
