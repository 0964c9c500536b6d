#include "AppControl.h"

#include <appfw/Launch.h>
#include <aul.h>
#include <base/Fault.h>

namespace {

int aulResult(int error) {
  switch (error) {
    case APP_CONTROL_ERROR_NONE:
      return AUL_R_OK;
    case APP_CONTROL_ERROR_APP_NOT_FOUND:
      return AUL_R_ENOAPP;
    case APP_CONTROL_ERROR_LAUNCH_REJECTED:
      return AUL_R_EREJECTED;
    case APP_CONTROL_ERROR_LAUNCH_FAILED:
      return AUL_R_ECOMM;
    default:
      return AUL_R_ERROR;
  }
}

}  // namespace

int aul_forward_app(const char* appid, bundle* kb) {
  if (base::strikes(__func__)) return AUL_R_ECOMM;
  if (!appid || !kb) return AUL_R_EINVAL;
  const std::string caller = appfw::textOf(*kb, AUL_K_CALLER_PID);
  if (caller.empty()) return AUL_R_EINVAL;
  kb->remove(AUL_K_ORG_CALLER_PID);
  kb->add(AUL_K_ORG_CALLER_PID, caller);
  return aulResult(appfw::launch(appid, *kb, {}));
}
