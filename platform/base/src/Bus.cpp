#include <base/Bus.h>
#include <dlog.h>

namespace base {
namespace {

common::OwnedBus connect(GBusType type, const char* name) {
  common::OwnedError error;
  common::OwnedBus bus(g_bus_get_sync(type, nullptr, common::Out(error)));
  if (!bus) dlog_print(DLOG_ERROR, "PLATFORM", "no %s bus: %s", name, error->message);
  return bus;
}

/// The bus works through a connection's messages in order: once it has answered this one, it has
/// dealt with those before.
void waitUntilSeen(GDBusConnection* bus) {
  common::OwnedVariant answer(g_dbus_connection_call_sync(
      bus, "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus", "GetId",
      nullptr, nullptr, G_DBUS_CALL_FLAGS_NONE, 1000, nullptr, nullptr));
}

}  // namespace

common::OwnedBus sessionBus() {
  return connect(G_BUS_TYPE_SESSION, "session");
}

common::OwnedBus systemBus() {
  return connect(G_BUS_TYPE_SYSTEM, "system");
}

SignalSubscription::SignalSubscription(common::OwnedBus bus, const Match& match,
                                       GDBusSignalCallback callback, void* data)
    : _bus(std::move(bus)) {
  if (!_bus) return;
  _id = g_dbus_connection_signal_subscribe(_bus.get(), match.sender, match.interface, match.member,
                                           match.path, match.arg0, G_DBUS_SIGNAL_FLAGS_NONE,
                                           callback, data, nullptr);
  waitUntilSeen(_bus.get());
}

SignalSubscription::~SignalSubscription() {
  if (_id) g_dbus_connection_signal_unsubscribe(_bus.get(), _id);
}

}  // namespace base
