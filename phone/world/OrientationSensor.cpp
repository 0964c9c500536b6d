#include "OrientationSensor.h"

namespace {

constexpr const char* kSensor = R"(<node><interface name="net.hadess.SensorProxy">
<method name="ClaimAccelerometer"/>
<method name="ReleaseAccelerometer"/>
<property name="HasAccelerometer" type="b" access="read"/>
<property name="AccelerometerOrientation" type="s" access="read"/>
<property name="HasAmbientLight" type="b" access="read"/>
<property name="HasProximity" type="b" access="read"/>
</interface></node>)";

}  // namespace

OrientationSensor::OrientationSensor(GDBusConnection* bus)
    : _object(bus, "/net/hadess/SensorProxy", kSensor), _bus(bus) {
  _object.set("HasAccelerometer", g_variant_new_boolean(TRUE));
  _object.set("HasAmbientLight", g_variant_new_boolean(FALSE));
  _object.set("HasProximity", g_variant_new_boolean(FALSE));
  turn(0);
  _object.onMethod("ClaimAccelerometer", [this](GVariant*, const std::string& client, GError**) {
    if (!_clients.count(client)) {
      _clients[client] = g_bus_watch_name_on_connection(
          _bus, client.c_str(), G_BUS_NAME_WATCHER_FLAGS_NONE, nullptr, _clientGone, this, nullptr);
    }
    return static_cast<GVariant*>(nullptr);
  });
  _object.onMethod("ReleaseAccelerometer", [this](GVariant*, const std::string& client, GError**) {
    _clientGone(nullptr, client.c_str(), this);
    return static_cast<GVariant*>(nullptr);
  });
  _object.tellOnly([this](const auto& tell) {
    for (const auto& client : _clients) tell(client.first.c_str());
  });
}

OrientationSensor::~OrientationSensor() {
  for (const auto& client : _clients) g_bus_unwatch_name(client.second);
}

void OrientationSensor::_clientGone(GDBusConnection*, const char* client, gpointer self) {
  auto& clients = static_cast<OrientationSensor*>(self)->_clients;
  const auto found = clients.find(client);
  if (found == clients.end()) return;
  const guint watch = found->second;
  clients.erase(found);
  g_bus_unwatch_name(watch);
}

bool OrientationSensor::turn(int degrees) {
  static const std::map<int, const char*> kNames = {
      {0, "normal"}, {90, "left-up"}, {180, "bottom-up"}, {270, "right-up"}};
  const auto name = kNames.find(degrees);
  if (name == kNames.end()) return false;
  _object.set("AccelerometerOrientation", g_variant_new_string(name->second));
  return true;
}
