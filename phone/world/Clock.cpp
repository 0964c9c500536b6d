#include "Clock.h"

namespace {

constexpr const char* kClock = R"(<node><interface name="org.freedesktop.timedate1">
<method name="SetTimezone">
<arg type="s" direction="in"/><arg type="b" direction="in"/>
</method>
<property name="Timezone" type="s" access="read"/>
<property name="LocalRTC" type="b" access="read"/>
<property name="CanNTP" type="b" access="read"/>
<property name="NTP" type="b" access="read"/>
<property name="NTPSynchronized" type="b" access="read"/>
</interface></node>)";

using Zone = common::Owned<GTimeZone, g_time_zone_unref>;

}  // namespace

Clock::Clock(GDBusConnection* bus) : _object(bus, "/org/freedesktop/timedate1", kClock) {
  const Zone here(g_time_zone_new_local());
  _object.set("Timezone", g_variant_new_string(g_time_zone_get_identifier(here.get())));
  _object.set("LocalRTC", g_variant_new_boolean(FALSE));
  for (const char* network : {"CanNTP", "NTP", "NTPSynchronized"}) {
    _object.set(network, g_variant_new_boolean(TRUE));
  }
  _object.onMethod("SetTimezone", [this](GVariant* arguments, const std::string&, GError** error) {
    return _setZone(arguments, error);
  });
}

GVariant* Clock::_setZone(GVariant* arguments, GError** error) {
  const char* name = nullptr;
  g_variant_get_child(arguments, 0, "&s", &name);
  if (const Zone zone(g_time_zone_new_identifier(name)); !zone) {
    g_set_error(error, G_DBUS_ERROR, G_DBUS_ERROR_INVALID_ARGS, "'%s' is not a time zone", name);
  } else {
    _object.set("Timezone", g_variant_new_string(name));
  }
  return nullptr;
}
