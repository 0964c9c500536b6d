#include <ovu.h>

#include <base/Fault.h>
#include <cstring>
#include <new>
#include <string>

#include "AccountStore.h"

struct ovu_handle_s {
  ovu::AccountStore store;
  std::string imsi;
};

int ovu_open_handle(ovu_h* handle) {
  if (base::strikes(__func__)) return OVU_ERROR_STORE;
  if (!handle) return OVU_ERROR_INVALID_PARAMETER;
  *handle = nullptr;
  auto* opened = new (std::nothrow) ovu_handle_s;
  if (!opened || !opened->store.isOpen()) {
    delete opened;
    return OVU_ERROR_STORE;
  }
  *handle = opened;
  return OVU_ERROR_NONE;
}

int ovu_check_account_exist(ovu_h handle, char** imsi, char** msisdn) {
  if (base::strikes(__func__)) return OVU_ERROR_STORE;
  if (!handle || !imsi) return OVU_ERROR_INVALID_PARAMETER;
  *imsi = nullptr;
  if (msisdn) *msisdn = nullptr;
  bool failed = false;
  const auto account = handle->store.account(&failed);
  if (failed) return OVU_ERROR_STORE;
  if (!account) return OVU_ERROR_NONE;
  *imsi = strdup(account->imsi.c_str());
  if (msisdn && !account->msisdn.empty()) *msisdn = strdup(account->msisdn.c_str());
  return OVU_ERROR_NONE;
}

int ovu_set_imsi(ovu_h handle, const char* imsi) {
  if (base::strikes(__func__)) return OVU_ERROR_STORE;
  if (!handle || !imsi) return OVU_ERROR_INVALID_PARAMETER;
  bool failed = false;
  const auto account = handle->store.account(&failed);
  if (failed) return OVU_ERROR_STORE;
  if (!account || account->imsi != imsi) return OVU_ERROR_NO_ACCOUNT;
  handle->imsi = imsi;
  return OVU_ERROR_NONE;
}

// The store is the only source on this phone, so `cached` makes no difference.
int ovu_get_service_status(ovu_h handle, const char* service, char** status, int /*cached*/) {
  if (base::strikes(__func__)) return OVU_ERROR_STORE;
  if (!handle || !service || !status) return OVU_ERROR_INVALID_PARAMETER;
  *status = nullptr;
  if (handle->imsi.empty()) return OVU_ERROR_NO_ACCOUNT;
  bool failed = false;
  const bool on = handle->store.isServiceOn(service, &failed);
  if (failed) return OVU_ERROR_STORE;
  *status = strdup(on ? "on" : "off");
  return OVU_ERROR_NONE;
}

int ovu_close_handle(ovu_h handle) {
  if (!handle) return OVU_ERROR_INVALID_PARAMETER;
  delete handle;
  return OVU_ERROR_NONE;
}
