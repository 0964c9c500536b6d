/// The one call to the notification daemon.
#pragma once

#include <common/Owned.h>

#include <string>

namespace notification {

constexpr const char* kService = "org.freedesktop.Notifications";
constexpr const char* kPath = "/org/freedesktop/Notifications";

struct Message {
  std::string text;  ///< plain; it is escaped for the daemon
  unsigned replaces = 0;
  const char* stackTag = nullptr;  ///< messages of one tag replace each other at once
  bool openable = false;
  int timeoutMs = 0;
};

/// Asynchronous; `callback` gets the answer "(u)", the message's number.
void notify(GDBusConnection* bus, const Message& message, GAsyncReadyCallback callback, void* data);

/// The number in a finished call's answer, or 0.
unsigned finishNotify(GObject* bus, GAsyncResult* result);

}  // namespace notification
