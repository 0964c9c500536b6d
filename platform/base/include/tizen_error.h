/// Error numbers common to all platform interfaces: 0 is success, generic failures are negated
/// errno values, a module's own failures are its base with a small number or-ed in.
#pragma once

#include <errno.h>

#ifdef __cplusplus
extern "C" {
#endif

#define TIZEN_ERROR_MIN_PLATFORM_ERROR (-1073741824)
#define TIZEN_ERROR_APPLICATION (-0x01100000)
#define TIZEN_ERROR_NOTIFICATION (-0x01140000)
#define TIZEN_ERROR_BUNDLE (-0x01180000)
#define TIZEN_ERROR_MIME_TYPE (-0x01600000)
#define TIZEN_ERROR_MEDIA_CONTENT (-0x01610000)
#define TIZEN_ERROR_CONNECTION (-0x01C10000)
#define TIZEN_ERROR_CONTACTS (-0x02010000)
#define TIZEN_ERROR_VCONF (-0x02210000)
#define TIZEN_ERROR_DLOG (-0x02410000)
#define TIZEN_ERROR_SYSTEM_SETTINGS (-0x02460000)

typedef enum {
  TIZEN_ERROR_NONE = 0,
  TIZEN_ERROR_NOT_PERMITTED = -EPERM,
  TIZEN_ERROR_NO_SUCH_FILE = -ENOENT,
  TIZEN_ERROR_IO_ERROR = -EIO,
  TIZEN_ERROR_OUT_OF_MEMORY = -ENOMEM,
  TIZEN_ERROR_PERMISSION_DENIED = -EACCES,
  TIZEN_ERROR_INVALID_PARAMETER = -EINVAL,
  TIZEN_ERROR_FILE_NO_SPACE_ON_DEVICE = -ENOSPC,
  TIZEN_ERROR_INVALID_OPERATION = -ENOSYS,
  TIZEN_ERROR_NO_DATA = -ENODATA,
  TIZEN_ERROR_ADDRESS_FAMILY_NOT_SUPPORTED = -EAFNOSUPPORT,
  TIZEN_ERROR_ALREADY_IN_PROGRESS = -EALREADY,
  TIZEN_ERROR_NOW_IN_PROGRESS = -EINPROGRESS,
  TIZEN_ERROR_KEY_NOT_AVAILABLE = -ENOKEY,
  TIZEN_ERROR_KEY_REJECTED = -EKEYREJECTED,
  TIZEN_ERROR_UNKNOWN = TIZEN_ERROR_MIN_PLATFORM_ERROR,
  TIZEN_ERROR_TIMED_OUT = TIZEN_ERROR_MIN_PLATFORM_ERROR + 1,
  TIZEN_ERROR_NOT_SUPPORTED = TIZEN_ERROR_MIN_PLATFORM_ERROR + 2
} tizen_error_e;

/// A short text for any error number of the platform. Never null, never freed.
char* get_error_message(int err);

/// What the last call of this thread that could not return an error itself came to.
int get_last_result(void);
void set_last_result(int err);

#ifdef __cplusplus
}
#endif
