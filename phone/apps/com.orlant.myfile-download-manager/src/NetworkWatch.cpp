#include "NetworkWatch.h"

#include <net_connection.h>

namespace downloads {
namespace {

Network currentNetwork() {
  connection_h connection = nullptr;
  connection_type_e type = CONNECTION_TYPE_DISCONNECTED;
  if (connection_create(&connection) == CONNECTION_ERROR_NONE) {
    connection_get_type(connection, &type);
    connection_destroy(connection);
  }
  if (type == CONNECTION_TYPE_DISCONNECTED) return Network::None;
  return type == CONNECTION_TYPE_WIFI ? Network::Wifi : Network::Other;
}

}  // namespace

NetworkWatch::NetworkWatch(std::function<void(Network)> onChange)
    : _onChange(std::move(onChange)),
      _changed(base::BusKind::System,
               {nullptr, "org.freedesktop.DBus.Properties", "PropertiesChanged",
                "/org/freedesktop/NetworkManager"},
               _changedCb, this) {
  _report();
}

void NetworkWatch::_changedCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                              GVariant*, void* data) {
  static_cast<NetworkWatch*>(data)->_report();
}

void NetworkWatch::_report() {
  _onChange(currentNetwork());
}

}  // namespace downloads
