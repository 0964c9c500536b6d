/// Account sign-up library: does this phone have an account, and which services are switched on
/// there. Answers from the phone's account store; never waits for the network. All calls return 0
/// on success.
#pragma once

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
  OVU_ERROR_NONE = 0,
  OVU_ERROR_INVALID_PARAMETER = -22,
  OVU_ERROR_STORE = -5,
  OVU_ERROR_NO_ACCOUNT = -61
} ovu_error_e;

typedef struct ovu_handle_s* ovu_h;

/// The sharing service's key for ovu_get_service_status.
#define OVU_SERVICE_SHARE "2"

int ovu_open_handle(ovu_h* handle);
/// `imsi` is the identity of the account on this phone, null when there is none; `msisdn` its
/// number, may be null. Both texts are new; the caller frees them with free().
int ovu_check_account_exist(ovu_h handle, char** imsi, char** msisdn);
/// Chooses the account that the following calls speak of.
int ovu_set_imsi(ovu_h handle, const char* imsi);
/// "on" or "off", a new text that the caller frees with free(). `cached` 1 answers from the store.
int ovu_get_service_status(ovu_h handle, const char* service, char** status, int cached);
int ovu_close_handle(ovu_h handle);

#ifdef __cplusplus
}
#endif
