#pragma once

#include <AccountStore.h>
#include <companion/Launch.h>
#include <zelqo/Account.h>
#include <zelqo/Store.h>

#include <string>

namespace ovuport {

/// Whose account the pages work on, and whom they tell how it went.
struct Subscriber {
  Subscriber(std::string msisdn, app_control_h request)
      : number(std::move(msisdn)), service(shares, number), reply(request) {}

  const std::string number;  ///< of this phone, empty when it has none
  ovu::AccountStore accounts;
  zelqo::Store shares;
  zelqo::Account service;
  companion::PendingReply reply;
};

}  // namespace ovuport
