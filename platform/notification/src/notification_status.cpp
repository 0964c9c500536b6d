#include <notification_status.h>

#include "Notify.h"

#include <base/Bus.h>

namespace {

constexpr int kShownMs = 3000;

/// The number of this process's last message, once the daemon has told it.
unsigned lastNumber = 0;

void shownCb(GObject* bus, GAsyncResult* result, void*) {
  lastNumber = notification::finishNotify(bus, result);
}

}  // namespace

int notification_status_message_post(const char* message) {
  if (!message || !*message) return NOTIFICATION_ERROR_INVALID_PARAMETER;
  common::OwnedBus bus = base::sessionBus();
  if (!bus) return NOTIFICATION_ERROR_FROM_DBUS;
  notification::Message status;
  status.text = message;
  status.replaces = lastNumber;
  status.stackTag = "status";
  status.timeoutMs = kShownMs;
  notification::notify(bus.get(), status, shownCb, nullptr);
  return NOTIFICATION_ERROR_NONE;
}
