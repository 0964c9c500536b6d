#include "TimeZoneWatch.h"

#include <dlog.h>
#include <time.h>
#include <unicode/ucal.h>
#include <unicode/ustring.h>

#include <cstdlib>
#include <vector>

namespace {

constexpr const char* kService = "org.freedesktop.timedate1";
constexpr const char* kPath = "/org/freedesktop/timedate1";
constexpr const char* kProperties = "org.freedesktop.DBus.Properties";
constexpr const char* kZone = "Timezone";

/// TZ takes more than names of zones, files among it.
bool isZoneName(const std::string& zone) {
  return !zone.empty() && zone.size() < 128 && g_ascii_isalpha(zone[0]) &&
         zone.find("..") == std::string::npos &&
         zone.find_first_not_of(
             "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789"
             "_+-/") == std::string::npos;
}

void setZone(const std::string& zone) {
  setenv("TZ", zone.c_str(), 1);
  tzset();
  std::vector<UChar> name(zone.size() + 1);
  u_charsToUChars(zone.c_str(), name.data(), static_cast<int32_t>(name.size()));
  UErrorCode status = U_ZERO_ERROR;
  ucal_setDefaultTimeZone(name.data(), &status);
}

}  // namespace

TimeZoneWatch::TimeZoneWatch(std::function<void()> onChanged)
    : _onChanged(std::move(onChanged)),
      _subscription(base::BusKind::System,
                    {kService, kProperties, "PropertiesChanged", kPath, kService}, changedCb, this),
      _busReturn(base::BusKind::System, [this] { ask(); }) {
  ask();
}

TimeZoneWatch::~TimeZoneWatch() {
  g_cancellable_cancel(_asking.get());
}

std::string TimeZoneWatch::current() {
  common::Owned<GTimeZone, g_time_zone_unref> zone(g_time_zone_new_local());
  return g_time_zone_get_identifier(zone.get());
}

void TimeZoneWatch::changedCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                              GVariant* arguments, void* data) {
  if (!g_variant_is_of_type(arguments, G_VARIANT_TYPE("(sa{sv}as)"))) return;
  auto* self = static_cast<TimeZoneWatch*>(data);
  common::OwnedVariant changed(g_variant_get_child_value(arguments, 1));
  const char* zone = nullptr;
  if (g_variant_lookup(changed.get(), kZone, "&s", &zone)) {
    self->apply(zone);
  } else {
    self->ask();
  }
}

void TimeZoneWatch::ask() {
  const common::OwnedBus bus = base::systemBus();
  if (!bus) return;
  g_dbus_connection_call(bus.get(), kService, kPath, kProperties, "Get",
                         g_variant_new("(ss)", kService, kZone), G_VARIANT_TYPE("(v)"),
                         G_DBUS_CALL_FLAGS_NO_AUTO_START, -1, _asking.get(), answeredCb, this);
}

void TimeZoneWatch::answeredCb(GObject* bus, GAsyncResult* result, void* data) {
  common::OwnedError error;
  common::OwnedVariant answer(
      g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, common::Out(error)));
  if (!answer) return;  // no such service, or the watch has gone
  GVariant* boxed = nullptr;
  g_variant_get(answer.get(), "(v)", &boxed);
  common::OwnedVariant zone(boxed);
  if (g_variant_is_of_type(boxed, G_VARIANT_TYPE_STRING)) {
    static_cast<TimeZoneWatch*>(data)->apply(g_variant_get_string(boxed, nullptr));
  }
}

void TimeZoneWatch::apply(const std::string& zone) {
  if (!isZoneName(zone)) {
    dlog_print(DLOG_ERROR, "SETTINGS", "no time zone: %s", zone.c_str());
    return;
  }
  if (zone == current()) return;
  setZone(zone);
  const auto onChanged = _onChanged;
  onChanged();
}
