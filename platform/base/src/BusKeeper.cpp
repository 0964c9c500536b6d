#include "BusKeeper.h"

#include <base/Deadline.h>
#include <dlog.h>

#include <cstdlib>
#include <set>

namespace base {
namespace {

constexpr const char* kTag = "PLATFORM";
constexpr guint kSeekAfterMs = 500;
constexpr const char* kNowhere = "unix:path=/nonexistent/bus";

bool isOpen(const common::OwnedBus& bus) {
  return bus && !g_dbus_connection_is_closed(bus.get());
}

}  // namespace

/// Never destroyed: connections are used until the process ends.
BusKeeper& BusKeeper::of(BusKind kind) {
  static auto* session = new BusKeeper(G_BUS_TYPE_SESSION, "session", "DBUS_SESSION_BUS_ADDRESS");
  static auto* system = new BusKeeper(G_BUS_TYPE_SYSTEM, "system", "DBUS_SYSTEM_BUS_ADDRESS");
  return kind == BusKind::Session ? *session : *system;
}

BusKeeper::BusKeeper(GBusType type, const char* name, const char* variable)
    : _type(type), _name(name), _variable(variable) {}

common::OwnedBus BusKeeper::get() {
  if (!isOpen(_bus) && _lockedAddress.empty()) connect();
  return isOpen(_bus) ? common::refer(_bus.get()) : nullptr;
}

unsigned BusKeeper::onReturn(std::function<void()> returned) {
  _waiting[++_lastWaiting] = std::move(returned);
  if (!get()) seekLater();
  return _lastWaiting;
}

void BusKeeper::connect() {
  const Deadline deadline(kBusPatience);
  common::OwnedError error;
  common::OwnedBus bus(g_bus_get_sync(_type, deadline.cancellable(), common::Out(error)));
  if (isOpen(bus)) {
    adopt(std::move(bus));
    return;
  }
  const bool silent = g_error_matches(error.get(), G_IO_ERROR, G_IO_ERROR_CANCELLED);
  say(silent ? "it does not answer" : error ? error->message : "it has closed");
  if (silent) lock();
  if (!_waiting.empty()) seekLater();
}

void BusKeeper::adopt(common::OwnedBus bus) {
  _bus = std::move(bus);
  _away = false;
  if (_type == G_BUS_TYPE_SYSTEM) g_dbus_connection_set_exit_on_close(_bus.get(), FALSE);
  g_signal_connect(_bus.get(), "closed", G_CALLBACK(closedCb), this);
}

/// Once for every time that it goes away.
void BusKeeper::say(const char* reason) {
  if (!_away) dlog_print(DLOG_ERROR, kTag, "no %s bus: %s", _name, reason);
  _away = true;
}

/// Connecting to a bus that is silent takes for ever, for everybody in this process who does it in
/// the usual way. So the way leads nowhere until the bus speaks.
void BusKeeper::lock() {
  const char* address = getenv(_variable);
  _lockedAddress = address ? address : "unix:path=/run/dbus/system_bus_socket";
  setenv(_variable, kNowhere, 1);
  seekLater();
}

void BusKeeper::unlock() {
  if (!_lockedAddress.empty()) setenv(_variable, _lockedAddress.c_str(), 1);
  _lockedAddress.clear();
}

void BusKeeper::closedCb(GDBusConnection*, gboolean, GError*, gpointer data) {
  auto* self = static_cast<BusKeeper*>(data);
  self->say("it has gone");
  self->_bus.reset();
  self->seekLater();
}

void BusKeeper::seekLater() {
  if (!_seeking) _seeking = g_timeout_add(kSeekAfterMs, seekCb, this);
}

/// Asynchronous, and a connection of our own: the one that this process shares stays closed while
/// anybody has it.
gboolean BusKeeper::seekCb(gpointer data) {
  auto* self = static_cast<BusKeeper*>(data);
  common::OwnedText address(self->_lockedAddress.empty()
                                ? g_dbus_address_get_for_bus_sync(self->_type, nullptr, nullptr)
                                : g_strdup(self->_lockedAddress.c_str()));
  const auto flags =
      static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                        G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION);
  g_dbus_connection_new_for_address(address ? address.get() : kNowhere, flags, nullptr, nullptr,
                                    foundCb, self);
  return G_SOURCE_REMOVE;
}

void BusKeeper::foundCb(GObject*, GAsyncResult* result, gpointer data) {
  auto* self = static_cast<BusKeeper*>(data);
  common::OwnedBus bus(g_dbus_connection_new_for_address_finish(result, nullptr));
  self->_seeking = 0;
  if (!isOpen(bus)) {
    self->seekLater();
    return;
  }
  self->unlock();
  if (!isOpen(self->_bus)) self->adopt(std::move(bus));
  self->tellReturn();
}

/// Who is told may stop waiting, and others begin to.
void BusKeeper::tellReturn() {
  std::set<unsigned> ids;
  for (const auto& entry : _waiting) ids.insert(entry.first);
  for (const unsigned id : ids) {
    const auto entry = _waiting.find(id);
    if (entry == _waiting.end()) continue;
    const auto returned = entry->second;
    returned();
  }
}

}  // namespace base
