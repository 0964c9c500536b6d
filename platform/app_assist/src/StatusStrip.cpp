#include "StatusStrip.h"

#include <common/Owned.h>
#include <net_connection.h>
#include <vconf-keys.h>

#include <cstring>
#include <ctime>
#include <string>

namespace app_assist {
namespace {

constexpr const char* kPowerSupplies = "/sys/class/power_supply";

const char* nameOf(connection_type_e type) {
  switch (type) {
    case CONNECTION_TYPE_WIFI:
      return "wifi";
    case CONNECTION_TYPE_CELLULAR:
      return "cellular";
    case CONNECTION_TYPE_DISCONNECTED:
      return "none";
    default:
      return "wired";
  }
}

connection_type_e currentNetwork() {
  connection_h connection = nullptr;
  connection_type_e type = CONNECTION_TYPE_DISCONNECTED;
  if (connection_create(&connection) != CONNECTION_ERROR_NONE) return type;
  if (connection_get_type(connection, &type) != CONNECTION_ERROR_NONE)
    type = CONNECTION_TYPE_DISCONNECTED;
  connection_destroy(connection);
  return type;
}

/// Percent as the kernel writes it, empty without a battery.
std::string batteryCharge() {
  const common::Owned<GDir, g_dir_close> folder(g_dir_open(kPowerSupplies, 0, nullptr));
  while (const char* name = folder ? g_dir_read_name(folder.get()) : nullptr) {
    if (strncmp(name, "BAT", 3) != 0) continue;
    char* text = nullptr;
    const common::OwnedText path(g_build_filename(kPowerSupplies, name, "capacity", nullptr));
    if (!g_file_get_contents(path.get(), &text, nullptr, nullptr)) continue;
    const common::OwnedText owned(g_strchomp(text));
    return owned.get();
  }
  return {};
}

}  // namespace

StatusStrip::StatusStrip(Evas_Object* layout) : _layout(layout) {
  showClock();
  showBattery();
  waitForNextMinute();
  vconf_notify_key_changed(VCONFKEY_REGIONFORMAT_TIME1224, clockFormatCb, this);
  _networkSignals = std::make_unique<base::SignalSubscription>(
      base::systemBus(),
      base::SignalSubscription::Match{nullptr, "org.freedesktop.DBus.Properties",
                                      "PropertiesChanged", "/org/freedesktop/NetworkManager"},
      networkSignalCb, this);
  showNetworkLater();
}

StatusStrip::~StatusStrip() {
  vconf_ignore_key_changed(VCONFKEY_REGIONFORMAT_TIME1224, clockFormatCb);
  if (_networkJob) ecore_job_del(_networkJob);
  ecore_timer_del(_minute);
}

void StatusStrip::showClock() {
  int format = VCONFKEY_TIME_FORMAT_24;
  vconf_get_int(VCONFKEY_REGIONFORMAT_TIME1224, &format);
  const time_t now = time(nullptr);
  tm local{};
  localtime_r(&now, &local);
  char text[32];
  const bool half = format == VCONFKEY_TIME_FORMAT_12;
  const size_t length = half ? strftime(text, sizeof text, "%l:%M %p", &local)
                             : strftime(text, sizeof text, "%H:%M", &local);
  const char* start = text;
  while (*start == ' ') start++;
  elm_object_part_text_set(_layout, "clock", length ? start : "");
}

void StatusStrip::showBattery() {
  const std::string charge = batteryCharge();
  elm_object_part_text_set(_layout, "battery", charge.empty() ? "" : (charge + "%").c_str());
  elm_object_signal_emit(_layout, charge.empty() ? "battery,hide" : "battery,show", "elm");
}

void StatusStrip::showNetwork() {
  const std::string signal = std::string("network,") + nameOf(currentNetwork());
  elm_object_signal_emit(_layout, signal.c_str(), "elm");
}

/// Asking may take a moment; the page comes first.
void StatusStrip::showNetworkLater() {
  if (!_networkJob) _networkJob = ecore_job_add(networkJobCb, this);
}

void StatusStrip::waitForNextMinute() {
  const time_t now = time(nullptr);
  _minute = ecore_timer_add(60.0 - static_cast<double>(now % 60), minuteCb, this);
}

Eina_Bool StatusStrip::minuteCb(void* data) {
  auto* self = static_cast<StatusStrip*>(data);
  self->showClock();
  self->showBattery();
  self->waitForNextMinute();
  return ECORE_CALLBACK_CANCEL;
}

void StatusStrip::networkJobCb(void* data) {
  auto* self = static_cast<StatusStrip*>(data);
  self->_networkJob = nullptr;
  self->showNetwork();
}

void StatusStrip::clockFormatCb(keynode_t*, void* data) {
  static_cast<StatusStrip*>(data)->showClock();
}

void StatusStrip::networkSignalCb(GDBusConnection*, const char*, const char*, const char*,
                                  const char*, GVariant*, void* data) {
  static_cast<StatusStrip*>(data)->showNetworkLater();
}

}  // namespace app_assist
