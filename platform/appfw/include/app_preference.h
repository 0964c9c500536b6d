/// The application's own key-value store. Persistent; any text is a key.
#pragma once

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  PREFERENCE_ERROR_NONE = TIZEN_ERROR_NONE,
  PREFERENCE_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
  PREFERENCE_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
  PREFERENCE_ERROR_NO_KEY = TIZEN_ERROR_APPLICATION | 0x30,
  PREFERENCE_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR
} preference_error_e;

/// True to go on.
typedef bool (*preference_item_cb)(const char* key, void* user_data);

/// Overwrites. Keys and values of at most 64 KiB.
int preference_set_string(const char* key, const char* value);
/// The caller frees the text with free().
int preference_get_string(const char* key, char** value);
int preference_is_existing(const char* key, bool* existing);
int preference_remove(const char* key);
int preference_remove_all(void);
/// In the order of the keys; the callback may change the store.
int preference_foreach_item(preference_item_cb callback, void* user_data);

#ifdef __cplusplus
}
#endif
