#include "Silence.h"

#include <common/Owned.h>

#include <climits>
#include <set>
#include <string>

namespace base {
namespace {

using Silent = std::pair<GDBusConnection*, std::string>;

std::set<Silent>& silent() {
  static auto* services = new std::set<Silent>;
  return *services;
}

/// An error is an answer, too: whoever is asked next gets it at once.
void spokeCb(GObject* bus, GAsyncResult* result, gpointer data) {
  const std::unique_ptr<Silent> service(static_cast<Silent*>(data));
  const common::OwnedVariant answer(
      g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, nullptr));
  silent().erase(*service);
}

}  // namespace

bool Silence::of(GDBusConnection* bus, const char* service) {
  return silent().count({bus, service}) > 0;
}

void Silence::begin(GDBusConnection* bus, const char* service) {
  if (!silent().emplace(bus, service).second) return;
  g_dbus_connection_call(bus, service, "/", "org.freedesktop.DBus.Peer", "Ping", nullptr, nullptr,
                         G_DBUS_CALL_FLAGS_NO_AUTO_START, INT_MAX, nullptr, spokeCb,
                         new Silent(bus, service));
}

}  // namespace base
