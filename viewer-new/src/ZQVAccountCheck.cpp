#include "ZQVAccountCheck.h"

#include "ZQVLog.h"
#include "ZQVOwned.h"

ZQVAccountCheck::~ZQVAccountCheck() {
  _close();
}

ZQVAccountCheck::Result ZQVAccountCheck::_checkOvuStatus() {
  ovu_h handle = nullptr;
  const int error = ovu_open_handle(&handle);
  if (error) {
    ZQV_ERROR("ovu_open_handle failed [%d]", error);
  } else {
    // A check that fails in the middle leaves its handle open.
    _close();
    _handle = handle;
    if (!_isOvuAccountExists()) {
      _isCheckPassed = false;
      return NoAccount;
    }
    _isServiceOn = false;
    _isCheckPassed = true;
    _checkOvuServiceStatus();
  }
  if (!_isCheckPassed) return NoAccount;
  return _isServiceOn ? Ok : SharingIsOff;
}

bool ZQVAccountCheck::_isOvuAccountExists() {
  ZQVPlatformText imsi;
  ZQVPlatformText msisdn;
  int error = ovu_check_account_exist(_handle, imsi.out(), msisdn.out());
  if (error) {
    ZQV_ERROR("ovu_exist_account_failed [%d]", error);
    return false;
  }
  if (!imsi) return false;
  error = ovu_set_imsi(_handle, imsi.get());
  if (error) ZQV_ERROR("ovu_set_imsi failed [%d]", error);
  return error == 0;
}

void ZQVAccountCheck::_checkOvuServiceStatus() {
  ZQVPlatformText status;
  const int error = ovu_get_service_status(_handle, OVU_SERVICE_SHARE, status.out(), 1);
  if (error) {
    ZQV_ERROR("ovu_get_service_status failed [%d]", error);
    ZQV_ERROR("share_check_ovu_service_status failed!");
    return;
  }
  if (status) {
    _isServiceOn = g_strcmp0(status.get(), "on") == 0;
  } else {
    ZQV_ERROR("service status is NULL");
  }
  _close();
}

void ZQVAccountCheck::_close() {
  if (_handle) ovu_close_handle(_handle);
  _handle = nullptr;
}
