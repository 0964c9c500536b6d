#include "Control.h"

namespace {

constexpr const char* kControl = R"(<node><interface name="phone.World1">
<method name="SetNetwork"><arg type="s" direction="in"/></method>
<method name="SetRotation"><arg type="i" direction="in"/></method>
<method name="SetCharge"><arg type="i" direction="in"/></method>
</interface></node>)";

}  // namespace

Control::Control(GDBusConnection* bus, Network& network, OrientationSensor& sensor,
                 Battery& battery)
    : _object(bus, "/phone/World", kControl) {
  _object.onMethod("SetNetwork", [&](GVariant* arguments, const std::string&, GError** error) {
    const char* kind = nullptr;
    g_variant_get(arguments, "(&s)", &kind);
    if (!network.change(kind)) {
      g_set_error(error, G_DBUS_ERROR, G_DBUS_ERROR_INVALID_ARGS, "no such network: %s", kind);
    }
    return static_cast<GVariant*>(nullptr);
  });
  _object.onMethod("SetRotation", [&](GVariant* arguments, const std::string&, GError** error) {
    gint degrees = 0;
    g_variant_get(arguments, "(i)", &degrees);
    if (!sensor.turn(degrees)) {
      g_set_error(error, G_DBUS_ERROR, G_DBUS_ERROR_INVALID_ARGS, "no such rotation: %d", degrees);
    }
    return static_cast<GVariant*>(nullptr);
  });
  _object.onMethod("SetCharge", [&](GVariant* arguments, const std::string&, GError** error) {
    gint percent = 0;
    g_variant_get(arguments, "(i)", &percent);
    if (!battery.charge(percent)) {
      g_set_error(error, G_DBUS_ERROR, G_DBUS_ERROR_INVALID_ARGS, "no such charge: %d", percent);
    }
    return static_cast<GVariant*>(nullptr);
  });
}
