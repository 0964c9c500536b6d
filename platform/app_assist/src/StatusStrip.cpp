#include "StatusStrip.h"

#include <common/Owned.h>
#include <net_connection.h>
#include <vconf-keys.h>

#include <cstdlib>
#include <ctime>
#include <string>

namespace app_assist {
namespace {

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
  if (connection_get_type(connection, &type) != CONNECTION_ERROR_NONE) {
    type = CONNECTION_TYPE_DISCONNECTED;
  }
  connection_destroy(connection);
  return type;
}

/// A fifth of the charge each, so that the picture of it has as many steps.
int levelOf(int percent) {
  return (percent + 10) / 20;
}

}  // namespace

StatusStrip::StatusStrip(Evas_Object* window, Evas_Object* layout)
    : _layout(layout),
      _banner(window),
      _battery([this](int percent) { showBattery(percent); }),
      _messages([this](const std::string& text) { showMessage(text); }) {
  showClock();
  waitForNextMinute();
  vconf_notify_key_changed(VCONFKEY_REGIONFORMAT_TIME1224, clockFormatCb, this);
  _networkSignals = std::make_unique<base::SignalSubscription>(
      base::BusKind::System,
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

void StatusStrip::showBattery(int percent) {
  const bool known = percent >= 0;
  elm_object_part_text_set(_layout, "battery",
                           known ? (std::to_string(percent) + "%").c_str() : "");
  const std::string signal = known ? "battery," + std::to_string(levelOf(percent)) : "battery,none";
  elm_object_signal_emit(_layout, signal.c_str(), "elm");
}

/// The banner has room for all of it; when that has gone, the strip keeps its beginning for a
/// while.
void StatusStrip::showMessage(const std::string& text) {
  const common::OwnedPlainText markup(evas_textblock_text_utf8_to_markup(nullptr, text.c_str()));
  elm_object_part_text_set(_layout, "message", markup.get());
  elm_object_signal_emit(_layout, "message,show", "elm");
  _banner.show(markup.get());
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
