/// Where the running application lives.
#pragma once

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  APP_ERROR_NONE = TIZEN_ERROR_NONE,
  APP_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
  APP_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
  APP_ERROR_INVALID_CONTEXT = TIZEN_ERROR_APPLICATION | 0x01,
  APP_ERROR_NO_SUCH_FILE = TIZEN_ERROR_NO_SUCH_FILE,
  APP_ERROR_ALREADY_RUNNING = TIZEN_ERROR_ALREADY_IN_PROGRESS
} app_error_e;

/// The caller frees the text with free().
int app_get_id(char** id);

/// Absolute, with a slash at the end, to be freed with free(); null outside an application. The
/// folder may not exist yet.
char* app_get_resource_path(void);
char* app_get_shared_resource_path(void);
char* app_get_data_path(void);
char* app_get_shared_data_path(void);
char* app_get_cache_path(void);
char* app_get_shared_trusted_path(void);

#ifdef __cplusplus
}
#endif
