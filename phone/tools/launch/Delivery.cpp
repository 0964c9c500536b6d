#include "Delivery.h"

#include <appfw/BusNames.h>

#include <chrono>
#include <cstring>

namespace {

constexpr auto kPatience = std::chrono::seconds(20);  // longer than the bus waits for a start

bool isLaunch(GDBusMessage* message) {
  const char* interface = g_dbus_message_get_interface(message);
  const char* member = g_dbus_message_get_member(message);
  return interface && member && strcmp(interface, appfw::kAppInterface) == 0 &&
         strcmp(member, "Launch") == 0;
}

}  // namespace

Delivery::Delivery(GDBusConnection* bus)
    : _bus(bus), _filter(g_dbus_connection_add_filter(bus, _filterCb, this, nullptr)) {}

Delivery::~Delivery() {
  g_dbus_connection_remove_filter(_bus, _filter);
}

GDBusMessage* Delivery::_filterCb(GDBusConnection*, GDBusMessage* message, gboolean incoming,
                                  gpointer self) {
  static_cast<Delivery*>(self)->_see(message, incoming);
  return message;
}

void Delivery::_see(GDBusMessage* message, bool incoming) {
  const std::lock_guard<std::mutex> lock(_mutex);
  if (!incoming) {
    if (isLaunch(message)) _serial = g_dbus_message_get_serial(message);
    return;
  }
  if (!_serial || g_dbus_message_get_reply_serial(message) != _serial) return;
  common::OwnedError error;
  if (g_dbus_message_to_gerror(message, common::Out(error))) {
    g_dbus_error_strip_remote_error(error.get());
    _reason = error->message;
  }
  _answered = true;
  _changed.notify_all();
}

bool Delivery::wait(std::string& reason) {
  std::unique_lock<std::mutex> lock(_mutex);
  if (!_changed.wait_for(lock, kPatience, [this] { return _answered; })) {
    _reason = "the application does not answer";
  }
  reason = _reason;
  return reason.empty();
}
