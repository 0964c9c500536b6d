#include "NetworkManager.h"

#include <base/Bus.h>
#include <dlog.h>

#include <string_view>

namespace {

using common::Out;
using common::OwnedError;
using common::OwnedVariant;

constexpr const char* kService = "org.freedesktop.NetworkManager";
constexpr const char* kPath = "/org/freedesktop/NetworkManager";

class Objects {
 public:
  /// All properties of one interface; null when there is no answer.
  OwnedVariant properties(const char* path, const char* interface) {
    if (!_bus) return nullptr;
    OwnedError error;
    const OwnedVariant answer = base::ask(_bus.get(),
                                          {kService, path, "org.freedesktop.DBus.Properties",
                                           "GetAll", g_variant_new("(s)", interface), "(a{sv})"},
                                          Out(error));
    if (!answer) {
      if (g_error_matches(error.get(), G_IO_ERROR, G_IO_ERROR_TIMED_OUT)) {
        dlog_print(DLOG_WARN, "CONNECTION", "NetworkManager does not answer");
      }
      return nullptr;
    }
    return OwnedVariant(g_variant_get_child_value(answer.get(), 0));
  }

 private:
  common::OwnedBus _bus = base::systemBus();
};

std::optional<connection_type_e> typeOfName(std::string_view name) {
  if (name == "802-11-wireless") return CONNECTION_TYPE_WIFI;
  if (name == "gsm" || name == "cdma") return CONNECTION_TYPE_CELLULAR;
  if (name == "802-3-ethernet") return CONNECTION_TYPE_ETHERNET;
  if (name == "bluetooth") return CONNECTION_TYPE_BT;
  return std::nullopt;
}

std::optional<connection_type_e> typeOfDevice(guint32 type) {
  switch (type) {
    case 1:
      return CONNECTION_TYPE_ETHERNET;
    case 2:
      return CONNECTION_TYPE_WIFI;
    case 5:
      return CONNECTION_TYPE_BT;
    case 8:
      return CONNECTION_TYPE_CELLULAR;
    default:
      return std::nullopt;
  }
}

std::string text(GVariant* properties, const char* name) {
  const char* value = nullptr;
  g_variant_lookup(properties, name, "&s", &value);
  return value ? value : "";
}

guint32 number(GVariant* properties, const char* name) {
  guint32 value = 0;
  g_variant_lookup(properties, name, "u", &value);
  return value;
}

/// The first of a list of object paths, or an empty text.
std::string firstPath(GVariant* properties, const char* name) {
  OwnedVariant list(g_variant_lookup_value(properties, name, G_VARIANT_TYPE_OBJECT_PATH_ARRAY));
  if (!list || g_variant_n_children(list.get()) == 0) return {};
  const char* path = nullptr;
  g_variant_get_child(list.get(), 0, "&o", &path);
  return path;
}

/// For a tunnel: what it runs over.
std::optional<connection_type_e> typeOfFirstConnection(Objects& objects, GVariant* manager) {
  const std::string path = firstPath(manager, "ActiveConnections");
  OwnedVariant active =
      path.empty()
          ? nullptr
          : objects.properties(path.c_str(), "org.freedesktop.NetworkManager.Connection.Active");
  if (!active) return std::nullopt;
  if (const auto type = typeOfName(text(active.get(), "Type"))) return type;
  const std::string device = firstPath(active.get(), "Devices");
  OwnedVariant properties =
      device.empty() ? nullptr
                     : objects.properties(device.c_str(), "org.freedesktop.NetworkManager.Device");
  return properties ? typeOfDevice(number(properties.get(), "DeviceType")) : std::nullopt;
}

}  // namespace

std::optional<connection_type_e> typeFromNetworkManager() {
  constexpr guint32 connectedLocally = 50;
  Objects objects;
  OwnedVariant manager = objects.properties(kPath, kService);
  if (!manager) return std::nullopt;
  if (number(manager.get(), "State") < connectedLocally) return CONNECTION_TYPE_DISCONNECTED;
  if (const auto type = typeOfName(text(manager.get(), "PrimaryConnectionType"))) return type;
  // Of a kind unknown here, but a connection.
  return typeOfFirstConnection(objects, manager.get()).value_or(CONNECTION_TYPE_ETHERNET);
}
