/// Media content: what the phone knows of the files on it, above all their thumbnails. Calls return
/// 0 or a negative media_content_error_e, and never wait for a thumbnail to be made.
#pragma once

#include <stdbool.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  MEDIA_CONTENT_ERROR_NONE = 0,
  MEDIA_CONTENT_ERROR_INVALID_PARAMETER = -22,
  MEDIA_CONTENT_ERROR_OUT_OF_MEMORY = -12,
  MEDIA_CONTENT_ERROR_INVALID_OPERATION = -38,
  MEDIA_CONTENT_FILE_NO_SPACE_ON_DEVICE = -28,
  MEDIA_CONTENT_ERROR_PERMISSION_DENIED = -13,
  MEDIA_CONTENT_ERROR_DB_FAILED = -23134207,
  MEDIA_CONTENT_ERROR_DB_BUSY = -23134206,
  MEDIA_CONTENT_ERROR_NETWORK = -23134205,
  MEDIA_CONTENT_ERROR_UNSUPPORTED_CONTENT = -23134204
} media_content_error_e;

typedef enum {
  MEDIA_CONTENT_COLLATE_DEFAULT = 0,
  MEDIA_CONTENT_COLLATE_NOCASE = 1,
  MEDIA_CONTENT_COLLATE_RTRIM = 2,
  MEDIA_CONTENT_COLLATE_LOCALIZED = 3
} media_content_collation_e;

/// The column that a condition may name.
#define MEDIA_PATH "MEDIA_PATH"

typedef struct filter_s* filter_h;
typedef struct media_info_s* media_info_h;

/// True asks for the next record. The handle is valid inside the callback only.
typedef bool (*media_info_cb)(media_info_h media, void* user_data);

int media_content_connect(void);
int media_content_disconnect(void);

/// The caller destroys the filter.
int media_filter_create(filter_h* filter);
int media_filter_destroy(filter_h filter);
/// `condition` is MEDIA_PATH = '<path>' with the single quotes of the path doubled; copied.
/// Anything else is an invalid parameter.
int media_filter_set_condition(filter_h filter, const char* condition,
                               media_content_collation_e collate_type);

/// All callbacks run inside the call; a null filter means every file of the media folder. Needs a
/// connection.
int media_info_foreach_media_from_db(filter_h filter, media_info_cb callback, void* user_data);

/// The clone outlives the callback and the connection; the caller destroys it.
int media_info_clone(media_info_h* dst, media_info_h src);
int media_info_destroy(media_info_h media);

/// New texts that the caller frees with free(); the thumbnail is null when there is none (yet).
int media_info_get_thumbnail_path(media_info_h media, char** path);
int media_info_get_file_path(media_info_h media, char** path);
int media_info_get_mime_type(media_info_h media, char** mime_type);
int media_info_get_display_name(media_info_h media, char** name);

#ifdef __cplusplus
}
#endif
