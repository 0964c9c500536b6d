/// Client library of the sharing service. Everything but zelqo_request_download and
/// zelqo_recall_upload answers from the phone's own store and never waits for the network; those
/// two work over HTTP and answer on the main loop. All calls return 0 on success.
#pragma once

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  ZELQO_ERROR_NONE = 0,
  ZELQO_ERROR_INVALID_PARAMETER = -22,
  ZELQO_ERROR_OUT_OF_MEMORY = -12,
  ZELQO_ERROR_NO_DATA = -61,
  ZELQO_ERROR_STORE = -5,
  ZELQO_ERROR_NETWORK = -101,
  ZELQO_ERROR_REFUSED = -111,
  ZELQO_ERROR_GONE = -410
} zelqo_error_e;

/// What the store knows of one share, received or sent. Owned by the library, never released by the
/// caller; valid until the process ends.
typedef struct zelqo_share_s* zelqo_share_h;

typedef struct {
  unsigned int index; /**< position in the order in which the sender chose them */
  char* msisdn;       /**< phone number, international form with a leading plus */
} zelqo_recipient_s;

/// A received share by its contents token.
int zelqo_push_info_get_handle(const char* contents_token, zelqo_share_h* handle);
/// The text belongs to the library.
int zelqo_push_info_get_sender_msisdn(zelqo_share_h handle, char** msisdn);
int zelqo_push_info_get_content_info_count(zelqo_share_h handle, unsigned int* count);
/// Milliseconds since the epoch.
int zelqo_push_info_get_expired_time(zelqo_share_h handle, unsigned long long* expired_time);

/// Texts are new; the caller frees them with free(). A text that the share lacks is
/// ZELQO_ERROR_NO_DATA and null.
int zelqo_content_info_get_file_size(zelqo_share_h handle, unsigned int index, unsigned int* size);
int zelqo_content_info_get_file_name(zelqo_share_h handle, unsigned int index, char** name);
int zelqo_content_info_get_content_type(zelqo_share_h handle, unsigned int index, char** type);
int zelqo_content_info_get_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url);
int zelqo_content_info_get_mid_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url);
int zelqo_content_info_get_big_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url);
int zelqo_content_info_get_download_url(zelqo_share_h handle, unsigned int index, char** url);

/// A share sent from this phone by its request id.
int zelqo_upload_info_get_handle(int request_id, zelqo_share_h* handle);
/// The array, its records and their texts belong to the library.
int zelqo_upload_info_get_recipient_msisdn_list(zelqo_share_h handle, zelqo_recipient_s*** list,
                                                unsigned int* count);
int zelqo_upload_info_get_content_info_count(zelqo_share_h handle, unsigned int* count);
/// A new text; the caller frees it with free().
int zelqo_upload_info_get_content_file_path(zelqo_share_h handle, unsigned int index, char** path);

/// Once per address, when its file is whole under its final name; with a null `download_path` when
/// it could not be fetched (`error` says why). The texts are valid during the call. The result is
/// not looked at.
typedef int (*zelqo_download_cb)(unsigned int request_id, int error, const char* download_path,
                                 const char* url, unsigned int remaining, void* user_data);

/// Fetches pictures into `folder`. `priority` 1 is the normal one; `flags` must be 0.
/// Refused (non-zero, no callback) for bad arguments or a folder that cannot be written.
int zelqo_request_download(const char** urls, unsigned int count, const char* folder, int priority,
                           int flags, zelqo_download_cb callback, void* user_data);

typedef void (*zelqo_recall_cb)(int error, void* user_data);

/// Withdraws a share that this phone sent; asking again is harmless. One callback.
int zelqo_recall_upload(unsigned int request_id, zelqo_recall_cb callback, void* user_data);

#ifdef __cplusplus
}
#endif
