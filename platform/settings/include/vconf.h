/// The phone's settings store, shared by all processes.
#pragma once

#include <vconf-keys.h>

#ifdef __cplusplus
extern "C" {
#endif

#define VCONF_OK 0
#define VCONF_ERROR (-1)

typedef struct _keynode_t keynode_t;
/// On the main loop, after the value has changed in whichever process.
typedef void (*vconf_callback_fn)(keynode_t* node, void* user_data);

/// New text, to be freed with free(); null when the key is unset or no text.
char* vconf_get_str(const char* in_key);
/// 0, or -1 when the key is unset or of another type.
int vconf_get_int(const char* in_key, int* intval);
int vconf_get_bool(const char* in_key, int* boolval);

/// 0, or -1. Texts of at most 4 KiB.
int vconf_set_str(const char* in_key, const char* strval);
int vconf_set_int(const char* in_key, int intval);
int vconf_set_bool(const char* in_key, int boolval);

/// Callbacks run in the order of registration. No change after the return of this call is missed.
int vconf_notify_key_changed(const char* in_key, vconf_callback_fn cb, void* user_data);
int vconf_ignore_key_changed(const char* in_key, vconf_callback_fn cb);

/// The key that changed; the text belongs to the node.
char* vconf_keynode_get_name(keynode_t* node);

#ifdef __cplusplus
}
#endif
