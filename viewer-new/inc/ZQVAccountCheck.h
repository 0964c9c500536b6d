#pragma once

#include <ovu.h>

/// Has this phone an account with the sign-up service, and is file sharing switched on there?
class ZQVAccountCheck {
 public:
  enum Result { Ok, SharingIsOff, NoAccount };

  ZQVAccountCheck() = default;
  ~ZQVAccountCheck();
  ZQVAccountCheck(const ZQVAccountCheck&) = delete;
  ZQVAccountCheck& operator=(const ZQVAccountCheck&) = delete;

  /// Asks anew. When the account library cannot be opened, the previous answer stands.
  Result _checkOvuStatus();

 private:
  bool _isOvuAccountExists();
  void _checkOvuServiceStatus();
  void _close();

  ovu_h _handle = nullptr;
  bool _isCheckPassed = false;
  bool _isServiceOn = false;
};
