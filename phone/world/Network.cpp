#include "Network.h"

#include <algorithm>
#include <iterator>

namespace {

constexpr const char* kManager = R"(<node><interface name="org.freedesktop.NetworkManager">
<method name="GetDevices"><arg type="ao" direction="out"/></method>
<method name="state"><arg type="u" direction="out"/></method>
<method name="CheckConnectivity"><arg type="u" direction="out"/></method>
<signal name="StateChanged"><arg type="u"/></signal>
<property name="State" type="u" access="read"/>
<property name="Connectivity" type="u" access="read"/>
<property name="PrimaryConnection" type="o" access="read"/>
<property name="PrimaryConnectionType" type="s" access="read"/>
<property name="ActiveConnections" type="ao" access="read"/>
<property name="Devices" type="ao" access="read"/>
<property name="NetworkingEnabled" type="b" access="read"/>
<property name="WirelessEnabled" type="b" access="read"/>
<property name="WwanEnabled" type="b" access="read"/>
<property name="Metered" type="u" access="read"/>
<property name="Version" type="s" access="read"/>
</interface></node>)";

constexpr const char* kConnection =
    R"(<node><interface name="org.freedesktop.NetworkManager.Connection.Active">
<property name="Id" type="s" access="read"/>
<property name="Uuid" type="s" access="read"/>
<property name="Type" type="s" access="read"/>
<property name="Devices" type="ao" access="read"/>
<property name="State" type="u" access="read"/>
<property name="Default" type="b" access="read"/>
<property name="Vpn" type="b" access="read"/>
</interface></node>)";

constexpr const char* kDevice = R"(<node><interface name="org.freedesktop.NetworkManager.Device">
<property name="Interface" type="s" access="read"/>
<property name="DeviceType" type="u" access="read"/>
<property name="State" type="u" access="read"/>
<property name="ActiveConnection" type="o" access="read"/>
</interface></node>)";

constexpr const char* kNoObject = "/";
constexpr guint kStateDisconnected = 20, kStateConnectedGlobal = 70;
constexpr guint kConnectivityNone = 1, kConnectivityFull = 4;
constexpr guint kMeteredYes = 1, kMeteredNo = 2;
constexpr guint kActive = 2, kDeviceActivated = 100, kDeviceDisconnected = 30;

struct Kind {
  const char* name;
  const char* type;
  const char* id;
  const char* interface;
  guint deviceType;
  guint metered;
};

constexpr Kind kKinds[] = {
    {"wifi", "802-11-wireless", "Home", "wlan0", 2, kMeteredNo},
    {"cellular", "gsm", "Mobile data", "wwan0", 8, kMeteredYes},
    {"ethernet", "802-3-ethernet", "Wired", "eth0", 1, kMeteredNo},
};

GVariant* paths(const char* path) {
  return path ? g_variant_new_objv(&path, 1) : g_variant_new_objv(nullptr, 0);
}

}  // namespace

Network::Network(GDBusConnection* bus)
    : _manager(bus, "/org/freedesktop/NetworkManager", kManager),
      _connection(bus, "/org/freedesktop/NetworkManager/ActiveConnection/1", kConnection),
      _device(bus, "/org/freedesktop/NetworkManager/Devices/1", kDevice) {
  for (const char* enabled : {"NetworkingEnabled", "WirelessEnabled", "WwanEnabled"}) {
    _manager.set(enabled, g_variant_new_boolean(TRUE));
  }
  _manager.set("Version", g_variant_new_string("1.42.4"));
  _manager.set("Devices", paths(_device.path().c_str()));
  _connection.set("Uuid", g_variant_new_string("3f0c1e5a-6d53-4a77-9c0a-2b8f6f1d7e01"));
  _connection.set("Devices", paths(_device.path().c_str()));
  _connection.set("State", g_variant_new_uint32(kActive));
  _connection.set("Default", g_variant_new_boolean(TRUE));
  _connection.set("Vpn", g_variant_new_boolean(FALSE));
  _manager.onMethod("GetDevices", [this](GVariant*, const std::string&, GError**) {
    return g_variant_new("(@ao)", _manager.get("Devices"));
  });
  _manager.onMethod("state", [this](GVariant*, const std::string&, GError**) {
    return g_variant_new("(@u)", _manager.get("State"));
  });
  _manager.onMethod("CheckConnectivity", [this](GVariant*, const std::string&, GError**) {
    return g_variant_new("(@u)", _manager.get("Connectivity"));
  });
  change("wifi");
}

bool Network::publish() {
  return _connection.publish() && _device.publish() && _manager.publish();
}

bool Network::change(const std::string& name) {
  const auto kind = std::find_if(std::begin(kKinds), std::end(kKinds),
                                 [&](const Kind& candidate) { return name == candidate.name; });
  const bool connected = kind != std::end(kKinds);
  if (!connected && name != "none") return false;
  const char* active = connected ? _connection.path().c_str() : nullptr;
  if (connected) {
    _connection.set("Type", g_variant_new_string(kind->type));
    _connection.set("Id", g_variant_new_string(kind->id));
    _device.set("Interface", g_variant_new_string(kind->interface));
    _device.set("DeviceType", g_variant_new_uint32(kind->deviceType));
  }
  _device.set("State", g_variant_new_uint32(connected ? kDeviceActivated : kDeviceDisconnected));
  _device.set("ActiveConnection", g_variant_new_object_path(active ? active : kNoObject));
  _manager.set("ActiveConnections", paths(active));
  _manager.set("PrimaryConnection", g_variant_new_object_path(active ? active : kNoObject));
  _manager.set("PrimaryConnectionType", g_variant_new_string(connected ? kind->type : ""));
  _manager.set("Metered", g_variant_new_uint32(connected ? kind->metered : 0));
  _manager.set("Connectivity",
               g_variant_new_uint32(connected ? kConnectivityFull : kConnectivityNone));
  const guint state = connected ? kStateConnectedGlobal : kStateDisconnected;
  _manager.set("State", g_variant_new_uint32(state));
  _manager.emit("StateChanged", g_variant_new("(u)", state));
  return true;
}
