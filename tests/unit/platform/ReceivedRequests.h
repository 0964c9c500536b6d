/// The test program as an application: everything that it is asked to do.
#pragma once

#include "TestPhone.h"

#include <app_control.h>
#include <appfw/AppService.h>

#include <string>
#include <vector>

class ReceivedRequests {
 public:
  ReceivedRequests();

  appfw::AppService& service() { return _service; }
  void start();
  /// Waits for so many requests altogether.
  bool waitFor(size_t count);
  app_control_h operator[](size_t index) const { return _requests[index].get(); }
  size_t count() const { return _requests.size(); }
  bool nameLost() const { return _nameLost; }

  static std::string extra(app_control_h request, const char* key);
  static std::vector<std::string> extraKeys(app_control_h request);
  /// "error -126" when there is none.
  static std::string caller(app_control_h request);

 private:
  using Request = common::Owned<app_control_s, app_control_destroy>;

  appfw::AppService _service{TestPhone::kAppId};
  std::vector<Request> _requests;
  bool _nameLost = false;
};
