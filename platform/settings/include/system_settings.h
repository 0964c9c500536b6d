/// System settings and their change notifications.
#pragma once

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  SYSTEM_SETTINGS_KEY_INCOMING_CALL_RINGTONE = 0,
  SYSTEM_SETTINGS_KEY_WALLPAPER_HOME_SCREEN = 1,
  SYSTEM_SETTINGS_KEY_WALLPAPER_LOCK_SCREEN = 2,
  SYSTEM_SETTINGS_KEY_FONT_SIZE = 3,
  SYSTEM_SETTINGS_KEY_FONT_TYPE = 4,
  SYSTEM_SETTINGS_KEY_MOTION_ACTIVATION = 5,
  SYSTEM_SETTINGS_KEY_EMAIL_ALERT_RINGTONE = 6,
  SYSTEM_SETTINGS_KEY_USB_DEBUGGING_ENABLED = 7,
  SYSTEM_SETTINGS_KEY_3G_DATA_NETWORK_ENABLED = 8,
  SYSTEM_SETTINGS_KEY_LOCKSCREEN_APP = 10,
  SYSTEM_SETTINGS_KEY_DEFAULT_FONT_TYPE = 11,
  SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY = 12,
  SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE = 13,
  SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR = 14,
  SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE = 15,
  SYSTEM_SETTINGS_KEY_TIME_CHANGED = 16,
  SYSTEM_SETTINGS_KEY_SOUND_LOCK = 17,
  SYSTEM_SETTINGS_KEY_SOUND_SILENT_MODE = 18,
  SYSTEM_SETTINGS_KEY_SOUND_TOUCH = 19,
  SYSTEM_SETTINGS_KEY_DISPLAY_SCREEN_ROTATION_AUTO = 20,
  SYSTEM_SETTINGS_KEY_DEVICE_NAME = 21,
  SYSTEM_SETTINGS_KEY_MOTION_ENABLED = 22,
  SYSTEM_SETTINGS_KEY_NETWORK_WIFI_NOTIFICATION = 23,
  SYSTEM_SETTINGS_KEY_NETWORK_FLIGHT_MODE = 24,
  SYSTEM_SETTINGS_KEY_SCREEN_BACKLIGHT_TIME = 25,
  SYSTEM_SETTINGS_KEY_SOUND_NOTIFICATION = 26,
  SYSTEM_SETTINGS_KEY_SOUND_NOTIFICATION_REPETITION_PERIOD = 27,
  SYSTEM_SETTINGS_KEY_LOCK_STATE = 28,
  SYSTEM_SETTINGS_KEY_MAX
} system_settings_key_e;

typedef enum {
  SYSTEM_SETTINGS_ERROR_NONE = TIZEN_ERROR_NONE,
  SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
  SYSTEM_SETTINGS_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
  SYSTEM_SETTINGS_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
  SYSTEM_SETTINGS_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
  SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
  SYSTEM_SETTINGS_ERROR_LOCKSCREEN_APP_PASSWORD_MODE = TIZEN_ERROR_SYSTEM_SETTINGS | 0x01
} system_settings_error_e;

/// On the main loop.
typedef void (*system_settings_changed_cb)(system_settings_key_e key, void* user_data);

/// One callback per key; a second one replaces the first. Country, language, 24-hour format, time
/// zone and time change are supported. Time change also reports a new time zone.
int system_settings_set_changed_cb(system_settings_key_e key, system_settings_changed_cb callback,
                                   void* user_data);
int system_settings_unset_changed_cb(system_settings_key_e key);

/// Country, language and time zone. The caller frees the text with free().
int system_settings_get_value_string(system_settings_key_e key, char** value);
/// 24-hour format.
int system_settings_get_value_bool(system_settings_key_e key, bool* value);
/// Country and language.
int system_settings_set_value_string(system_settings_key_e key, const char* value);
/// 24-hour format.
int system_settings_set_value_bool(system_settings_key_e key, bool value);

#ifdef __cplusplus
}
#endif
