/// Keyed texts and text arrays in the order in which they were added. Everything passed in is
/// copied.
#pragma once

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct _bundle_t bundle;
typedef struct keyval_t bundle_keyval_t;
typedef unsigned char bundle_raw;

typedef enum {
  BUNDLE_ERROR_NONE = TIZEN_ERROR_NONE,
  BUNDLE_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
  BUNDLE_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
  BUNDLE_ERROR_KEY_NOT_AVAILABLE = TIZEN_ERROR_KEY_NOT_AVAILABLE,
  BUNDLE_ERROR_KEY_EXISTS = TIZEN_ERROR_BUNDLE | 0x01
} bundle_error_e;

enum bundle_type_property { BUNDLE_TYPE_ARRAY = 0x0100, BUNDLE_TYPE_PRIMITIVE = 0x0200 };

enum bundle_type {
  BUNDLE_TYPE_NONE = -1,
  BUNDLE_TYPE_ANY = 0,
  BUNDLE_TYPE_BYTE = 2,
  BUNDLE_TYPE_BYTE_ARRAY = 0x102,
  BUNDLE_TYPE_STR = 0x401,
  BUNDLE_TYPE_STR_ARRAY = 0x501
};

typedef void (*bundle_iterator_t)(const char* key, const int type, const bundle_keyval_t* kv,
                                  void* user_data);

/// The caller frees it with bundle_free().
bundle* bundle_create(void);
int bundle_free(bundle* b);
bundle* bundle_dup(bundle* b_from);

/// An existing key is BUNDLE_ERROR_KEY_EXISTS and stays as it is.
int bundle_add_str(bundle* b, const char* key, const char* str);
int bundle_add(bundle* b, const char* key, const char* val);
/// A null entry becomes an empty text.
int bundle_add_str_array(bundle* b, const char* key, const char** str_array, const int len);
int bundle_del(bundle* b, const char* key);

/// What the getters answer belongs to the bundle and is valid until its key is deleted. A key of
/// another type is BUNDLE_ERROR_INVALID_PARAMETER, or null with that as get_last_result().
int bundle_get_str(bundle* b, const char* key, char** str);
const char* bundle_get_val(bundle* b, const char* key);
const char** bundle_get_str_array(bundle* b, const char* key, int* len);
int bundle_get_count(bundle* b);
/// One of enum bundle_type; BUNDLE_TYPE_NONE when there is no such key.
int bundle_get_type(bundle* b, const char* key);
/// In order of addition. The callback must not change the bundle.
void bundle_foreach(bundle* b, bundle_iterator_t iter, void* user_data);

/// The bytes are the caller's, to be freed with free().
int bundle_encode(bundle* b, bundle_raw** r, int* len);
/// Null when the bytes are not a bundle, whatever they are instead.
bundle* bundle_decode(const bundle_raw* r, const int len);

#ifdef __cplusplus
}
#endif
