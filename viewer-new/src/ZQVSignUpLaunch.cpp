#include "ZQVSignUpLaunch.h"

#include <app_control_internal.h>
#include <aul.h>

#include "ZQVLog.h"

namespace {

constexpr const char* kSignUpApp = "com.orlant.ovuport";
constexpr const char* kAuthOperation = "http://tizen.org/appcontrol/operation/auth";
constexpr const char* kSettingOperation = "http://tizen.org/appcontrol/operation/setting";

}  // namespace

void ZQVSignUpLaunch::setLaunchRequest(app_control_h request) {
  _request.reset();
  if (request) app_control_clone(_request.out(), request);
}

void ZQVSignUpLaunch::_launchOvu() {
  ZQVOwnedAppControl launch;
  app_control_clone(launch.out(), _request.get());
  int error = app_control_set_app_id(launch.get(), kSignUpApp);
  if (error) {
    ZQV_ERROR("app_control_set_app_id error (%d)", error);
    return;
  }
  error = app_control_set_operation(launch.get(), kAuthOperation);
  if (error) {
    ZQV_ERROR("app_control_set_operation error (%d)", error);
    return;
  }
  const char* server[] = {"keld"};
  app_control_add_extra_data_array(launch.get(), "server", server, 1);
  error = app_control_set_launch_mode(launch.get(), APP_CONTROL_LAUNCH_MODE_SINGLE);
  if (error) {
    ZQV_ERROR("app_control_set_launch_mode error (%d)", error);
    return;
  }
  error = app_control_export_as_bundle(launch.get(), _bundle.out());
  if (error) {
    ZQV_ERROR("app_control_export_as_bundle error (%d)", error);
    return;
  }
  _forward();
}

void ZQVSignUpLaunch::_launchOvuSettingUi() {
  ZQVOwnedAppControl launch;
  app_control_clone(launch.out(), _request.get());
  int error = app_control_set_app_id(launch.get(), kSignUpApp);
  if (error) {
    ZQV_ERROR("app_control_set_app_id error (%d)", error);
    return;
  }
  error = app_control_set_operation(launch.get(), kSettingOperation);
  if (error) {
    ZQV_ERROR("app_control_set_operation error (%d)", error);
    return;
  }
  error = app_control_export_as_bundle(launch.get(), _bundle.out());
  // Unlike the authentication page, this one is forwarded all the same.
  if (error) ZQV_ERROR("app_control_export_as_bundle error (%d)", error);
  _forward();
}

void ZQVSignUpLaunch::_forward() {
  if (aul_forward_app(kSignUpApp, _bundle.get()) < 0) {
    ZQV_ERROR("app(com.orlant.ovuport) launch failed!");
    return;
  }
  bundle_add_str(_bundle.get(), "__APP_SVC_START_INFO__", kSignUpApp);
}
