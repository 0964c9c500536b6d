#include <base/Fault.h>
#include <notification_status.h>

#include <base/Bus.h>

#include "Notify.h"
#include "StatusSignal.h"

namespace {

constexpr int kShownMs = 3000;

/// The number of this process's last message, once the daemon has told it.
unsigned lastNumber = 0;

/// The status bars of the applications show it; the notification daemon keeps what was said.
void tellStatusBars(GDBusConnection* bus, const char* message) {
  const common::OwnedText valid(g_utf8_make_valid(message, -1));
  g_dbus_connection_emit_signal(bus, nullptr, notification::kStatusBarPath,
                                notification::kStatusBar, notification::kPosted,
                                g_variant_new("(s)", valid.get()), nullptr);
}

void shownCb(GObject* bus, GAsyncResult* result, void*) {
  lastNumber = notification::finishNotify(bus, result);
}

}  // namespace

int notification_status_message_post(const char* message) {
  if (base::strikes(__func__)) return NOTIFICATION_ERROR_FROM_DBUS;
  if (!message || !*message) return NOTIFICATION_ERROR_INVALID_PARAMETER;
  common::OwnedBus bus = base::sessionBus();
  if (!bus) return NOTIFICATION_ERROR_FROM_DBUS;
  tellStatusBars(bus.get(), message);
  notification::Message status;
  status.text = message;
  status.replaces = lastNumber;
  status.stackTag = "status";
  status.timeoutMs = kShownMs;
  notification::notify(bus.get(), status, shownCb, nullptr);
  return NOTIFICATION_ERROR_NONE;
}
