/// Launch requests. Texts passed in are copied; texts handed out are the caller's, to be freed with
/// free(). All calls answer 0 or one of app_control_error_e.
#pragma once

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct app_control_s* app_control_h;
typedef struct _bundle_t bundle;

typedef enum {
  APP_CONTROL_ERROR_NONE = TIZEN_ERROR_NONE,
  APP_CONTROL_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
  APP_CONTROL_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
  APP_CONTROL_ERROR_APP_NOT_FOUND = TIZEN_ERROR_APPLICATION | 0x21,
  APP_CONTROL_ERROR_KEY_NOT_FOUND = TIZEN_ERROR_KEY_NOT_AVAILABLE,
  APP_CONTROL_ERROR_KEY_REJECTED = TIZEN_ERROR_KEY_REJECTED,
  APP_CONTROL_ERROR_INVALID_DATA_TYPE = TIZEN_ERROR_APPLICATION | 0x22,
  APP_CONTROL_ERROR_LAUNCH_REJECTED = TIZEN_ERROR_APPLICATION | 0x23,
  APP_CONTROL_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
  APP_CONTROL_ERROR_LAUNCH_FAILED = TIZEN_ERROR_APPLICATION | 0x24,
  APP_CONTROL_ERROR_TIMED_OUT = TIZEN_ERROR_TIMED_OUT,
  APP_CONTROL_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR
} app_control_error_e;

typedef enum {
  APP_CONTROL_RESULT_APP_STARTED = 1,
  APP_CONTROL_RESULT_SUCCEEDED = 0,
  APP_CONTROL_RESULT_FAILED = -1,
  APP_CONTROL_RESULT_CANCELED = -2
} app_control_result_e;

typedef enum {
  APP_CONTROL_LAUNCH_MODE_SINGLE = 0,
  APP_CONTROL_LAUNCH_MODE_GROUP
} app_control_launch_mode_e;

#define APP_CONTROL_OPERATION_MAIN "http://tizen.org/appcontrol/operation/main"
#define APP_CONTROL_OPERATION_DEFAULT "http://tizen.org/appcontrol/operation/default"
#define APP_CONTROL_OPERATION_EDIT "http://tizen.org/appcontrol/operation/edit"
#define APP_CONTROL_OPERATION_VIEW "http://tizen.org/appcontrol/operation/view"
#define APP_CONTROL_OPERATION_PICK "http://tizen.org/appcontrol/operation/pick"
#define APP_CONTROL_OPERATION_CREATE_CONTENT "http://tizen.org/appcontrol/operation/create_content"
#define APP_CONTROL_OPERATION_CALL "http://tizen.org/appcontrol/operation/call"
#define APP_CONTROL_OPERATION_SEND "http://tizen.org/appcontrol/operation/send"
#define APP_CONTROL_OPERATION_SEND_TEXT "http://tizen.org/appcontrol/operation/send_text"
#define APP_CONTROL_OPERATION_SHARE_TEXT "http://tizen.org/appcontrol/operation/share_text"
#define APP_CONTROL_OPERATION_DIAL "http://tizen.org/appcontrol/operation/dial"
#define APP_CONTROL_OPERATION_SEARCH "http://tizen.org/appcontrol/operation/search"
#define APP_CONTROL_OPERATION_DOWNLOAD "http://tizen.org/appcontrol/operation/download"
#define APP_CONTROL_OPERATION_PRINT "http://tizen.org/appcontrol/operation/print"
#define APP_CONTROL_OPERATION_COMPOSE "http://tizen.org/appcontrol/operation/compose"
#define APP_CONTROL_OPERATION_SHARE "http://tizen.org/appcontrol/operation/share"
#define APP_CONTROL_OPERATION_MULTI_SHARE "http://tizen.org/appcontrol/operation/multi_share"
#define APP_CONTROL_OPERATION_ADD "http://tizen.org/appcontrol/operation/add"

#define APP_CONTROL_DATA_PATH "http://tizen.org/appcontrol/data/path"
#define APP_CONTROL_DATA_TEXT "http://tizen.org/appcontrol/data/text"
#define APP_CONTROL_DATA_SELECTED "http://tizen.org/appcontrol/data/selected"

/// On the main loop, once. Neither handle is freed by the application.
typedef void (*app_control_reply_cb)(app_control_h request, app_control_h reply,
                                     app_control_result_e result, void* user_data);
/// True to go on.
typedef bool (*app_control_extra_data_cb)(app_control_h app_control, const char* key,
                                          void* user_data);

int app_control_create(app_control_h* app_control);
int app_control_destroy(app_control_h app_control);
int app_control_clone(app_control_h* clone, app_control_h app_control);

/// Null clears; what is not set is answered as success with null.
int app_control_set_operation(app_control_h app_control, const char* operation);
int app_control_get_operation(app_control_h app_control, char** operation);
int app_control_set_uri(app_control_h app_control, const char* uri);
int app_control_get_uri(app_control_h app_control, char** uri);
int app_control_set_mime(app_control_h app_control, const char* mime);
int app_control_get_mime(app_control_h app_control, char** mime);
int app_control_set_app_id(app_control_h app_control, const char* app_id);
int app_control_get_app_id(app_control_h app_control, char** app_id);
int app_control_set_launch_mode(app_control_h app_control, app_control_launch_mode_e mode);
/// Single when none is set.
int app_control_get_launch_mode(app_control_h app_control, app_control_launch_mode_e* mode);

/// An existing key is replaced. An empty key or value is an invalid parameter, one of the system's
/// own keys is rejected.
int app_control_add_extra_data(app_control_h app_control, const char* key, const char* value);
int app_control_add_extra_data_array(app_control_h app_control, const char* key,
                                     const char* value[], int length);
int app_control_remove_extra_data(app_control_h app_control, const char* key);
int app_control_get_extra_data(app_control_h app_control, const char* key, char** value);
/// The array and each of its texts are separate blocks.
int app_control_get_extra_data_array(app_control_h app_control, const char* key, char*** value,
                                     int* length);
int app_control_is_extra_data_array(app_control_h app_control, const char* key, bool* array);
/// In order of addition, without the system's own keys.
int app_control_foreach_extra_data(app_control_h app_control, app_control_extra_data_cb callback,
                                   void* user_data);

/// Both only for a request that was received. The caller is who the bus says it is;
/// APP_CONTROL_ERROR_KEY_NOT_FOUND when it is no application of this phone.
int app_control_get_caller(app_control_h app_control, char** id);
int app_control_is_reply_requested(app_control_h app_control, bool* requested);

/// Returns without waiting for the application. The handle may be destroyed right afterwards. With
/// a callback, a reply always comes: a failed one when the application goes away without one.
int app_control_send_launch_request(app_control_h app_control, app_control_reply_cb callback,
                                    void* user_data);
/// Invalid parameter when `request` asked for no reply.
int app_control_reply_to_launch_request(app_control_h reply, app_control_h request,
                                        app_control_result_e result);

#ifdef __cplusplus
}
#endif
