#include <system_settings.h>

#include "ClockWatch.h"
#include "TimeZoneWatch.h"

#include <base/Fault.h>
#include <vconf.h>

#include <cstdlib>
#include <cstring>
#include <map>
#include <memory>
#include <string>
#include <string_view>

namespace {

struct Listener {
  system_settings_changed_cb callback;
  void* data;
};

struct TimeWatch {
  TimeWatch();
  ClockWatch clock;
  TimeZoneWatch zone;
};

std::map<system_settings_key_e, Listener>& listeners() {
  static std::map<system_settings_key_e, Listener> listeners;
  return listeners;
}

/// While somebody listens to the time or its zone.
std::unique_ptr<TimeWatch>& timeWatch() {
  static std::unique_ptr<TimeWatch> watch;
  return watch;
}

/// The settings store's key, or null for what does not come from there.
const char* vconfKey(system_settings_key_e key) {
  switch (key) {
    case SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY:
      return VCONFKEY_REGIONFORMAT;
    case SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE:
      return VCONFKEY_LANGSET;
    case SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR:
      return VCONFKEY_REGIONFORMAT_TIME1224;
    default:
      return nullptr;
  }
}

bool isTime(system_settings_key_e key) {
  return key == SYSTEM_SETTINGS_KEY_TIME_CHANGED || key == SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE;
}

bool isLocale(system_settings_key_e key) {
  return key == SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY || key == SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE;
}

void fire(system_settings_key_e key) {
  const auto listener = listeners().find(key);
  if (listener == listeners().end()) return;
  const Listener called = listener->second;  // it may unset itself
  called.callback(key, called.data);
}

void vconfChangedCb(keynode_t* node, void*) {
  const std::string_view changed = vconf_keynode_get_name(node);
  for (const auto key : {SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY, SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE,
                         SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR}) {
    if (changed == vconfKey(key)) fire(key);
  }
}

TimeWatch::TimeWatch()
    : clock([] { fire(SYSTEM_SETTINGS_KEY_TIME_CHANGED); }), zone([] {
        fire(SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE);
        fire(SYSTEM_SETTINGS_KEY_TIME_CHANGED);
      }) {}

bool timeListenedTo() {
  return listeners().count(SYSTEM_SETTINGS_KEY_TIME_CHANGED) ||
         listeners().count(SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE);
}

std::string localeFromEnvironment(const char* category) {
  for (const char* name : {"LC_ALL", category, "LANG"}) {
    const char* locale = getenv(name);
    if (locale && *locale) return locale;
  }
  return "en_US.UTF-8";
}

std::string localeOf(system_settings_key_e key) {
  char* stored = vconf_get_str(vconfKey(key));
  const bool language = key == SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE;
  std::string locale =
      stored ? stored : localeFromEnvironment(language ? "LC_MESSAGES" : "LC_TIME");
  free(stored);
  return locale;
}

}  // namespace

int system_settings_set_changed_cb(system_settings_key_e key, system_settings_changed_cb callback,
                                   void* user_data) {
  if (base::strikes(__func__)) return SYSTEM_SETTINGS_ERROR_IO_ERROR;
  if (!callback) return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
  const char* stored = vconfKey(key);
  if (!stored && !isTime(key)) return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
  const bool first = listeners().insert_or_assign(key, Listener{callback, user_data}).second;
  if (first && stored) vconf_notify_key_changed(stored, vconfChangedCb, nullptr);
  if (isTime(key) && !timeWatch()) timeWatch() = std::make_unique<TimeWatch>();
  return SYSTEM_SETTINGS_ERROR_NONE;
}

int system_settings_unset_changed_cb(system_settings_key_e key) {
  if (base::strikes(__func__)) return SYSTEM_SETTINGS_ERROR_IO_ERROR;
  const char* stored = vconfKey(key);
  if (!stored && !isTime(key)) return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
  const bool listened = listeners().erase(key) > 0;
  if (listened && stored) vconf_ignore_key_changed(stored, vconfChangedCb);
  if (!timeListenedTo()) timeWatch().reset();
  return SYSTEM_SETTINGS_ERROR_NONE;
}

int system_settings_get_value_string(system_settings_key_e key, char** value) {
  if (!value) return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
  *value = nullptr;
  if (!isLocale(key) && key != SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE) {
    return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
  }
  const std::string text = isLocale(key) ? localeOf(key) : TimeZoneWatch::current();
  *value = strdup(text.c_str());
  return *value ? SYSTEM_SETTINGS_ERROR_NONE : SYSTEM_SETTINGS_ERROR_OUT_OF_MEMORY;
}

int system_settings_get_value_bool(system_settings_key_e key, bool* value) {
  if (!value) return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
  if (key != SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR) {
    return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
  }
  int format = VCONFKEY_TIME_FORMAT_12;
  vconf_get_int(VCONFKEY_REGIONFORMAT_TIME1224, &format);
  *value = format == VCONFKEY_TIME_FORMAT_24;
  return SYSTEM_SETTINGS_ERROR_NONE;
}

int system_settings_set_value_string(system_settings_key_e key, const char* value) {
  if (!value || !*value) return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
  if (!isLocale(key)) return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
  return vconf_set_str(vconfKey(key), value) == VCONF_OK ? SYSTEM_SETTINGS_ERROR_NONE
                                                         : SYSTEM_SETTINGS_ERROR_IO_ERROR;
}

int system_settings_set_value_bool(system_settings_key_e key, bool value) {
  if (key != SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR) {
    return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
  }
  const int format = value ? VCONFKEY_TIME_FORMAT_24 : VCONFKEY_TIME_FORMAT_12;
  return vconf_set_int(VCONFKEY_REGIONFORMAT_TIME1224, format) == VCONF_OK
             ? SYSTEM_SETTINGS_ERROR_NONE
             : SYSTEM_SETTINGS_ERROR_IO_ERROR;
}
