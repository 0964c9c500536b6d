/// MIME types by file extension. Calls return 0 or a negative mime_type_error_e.
#pragma once

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  MIME_TYPE_ERROR_NONE = 0,
  MIME_TYPE_ERROR_INVALID_PARAMETER = -22,
  MIME_TYPE_ERROR_OUT_OF_MEMORY = -12,
  MIME_TYPE_ERROR_IO_ERROR = -5
} mime_type_error_e;

/// `file_extension` without the dot, in any case. The type is a new text that the caller frees with
/// free(); an unknown extension is a success with "application/octet-stream".
int mime_type_get_mime_type(const char* file_extension, char** mime_type);

#ifdef __cplusplus
}
#endif
