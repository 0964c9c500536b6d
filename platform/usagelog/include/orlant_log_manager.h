/// Client of the platform's usage-statistics log. All calls return 0 on success.
#pragma once

#include <bundle.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  ORLANT_LOG_ERROR_NONE = 0,
  ORLANT_LOG_ERROR_INVALID_PARAMETER = -22,
  ORLANT_LOG_ERROR_STORE = -5
} orlant_log_error_e;

typedef struct orlant_log_manager_s* orlant_log_manager_h;

/// Called on the main loop when the record is stored or refused; not after the handle is destroyed.
typedef void (*orlant_log_manager_reply_cb)(int request_id, int error, void* user_data);

int orlant_log_manager_create(orlant_log_manager_h* handle);
/// Inserts one record; `data` holds texts only and is copied. A null handle is an invalid
/// parameter.
int orlant_log_manager_insert(orlant_log_manager_h handle, const char* content_uri, bundle* data,
                              orlant_log_manager_reply_cb callback, void* user_data,
                              int* request_id);
int orlant_log_manager_destroy(orlant_log_manager_h handle);

#ifdef __cplusplus
}
#endif
