#include "Battery.h"

namespace {

constexpr const char* kDevice = R"(<node><interface name="org.freedesktop.UPower.Device">
<property name="Type" type="u" access="read"/>
<property name="IsPresent" type="b" access="read"/>
<property name="Percentage" type="d" access="read"/>
<property name="State" type="u" access="read"/>
</interface></node>)";

constexpr guint32 kBattery = 2;
constexpr guint32 kDischarging = 2;
constexpr int kAtFirst = 84;

}  // namespace

Battery::Battery(GDBusConnection* bus)
    : _device(bus, "/org/freedesktop/UPower/devices/DisplayDevice", kDevice) {
  _device.set("Type", g_variant_new_uint32(kBattery));
  _device.set("IsPresent", g_variant_new_boolean(TRUE));
  _device.set("State", g_variant_new_uint32(kDischarging));
  charge(kAtFirst);
}

bool Battery::charge(int percent) {
  if (percent < 0 || percent > 100) return false;
  _device.set("Percentage", g_variant_new_double(percent));
  return true;
}
