#pragma once

#include "ZQVOwned.h"

/// Brings up the account sign-up application with a copy of the request that started the viewer.
class ZQVSignUpLaunch {
 public:
  ZQVSignUpLaunch() = default;
  ZQVSignUpLaunch(const ZQVSignUpLaunch&) = delete;
  ZQVSignUpLaunch& operator=(const ZQVSignUpLaunch&) = delete;

  /// Keeps a clone of the request; null forgets the one before.
  void setLaunchRequest(app_control_h request);

  /// Its authentication page.
  void _launchOvu();
  /// Its settings page.
  void _launchOvuSettingUi();

 private:
  void _forward();

  ZQVOwnedAppControl _request;
  ZQVOwnedBundle _bundle;
};
