/// A number's standing with the sharing service. Answers come on the main loop, one per call, none
/// after the object is gone; `error` is 0 or one of zelqo_error_e.
#pragma once

#include <zelqo/Store.h>

#include <functional>
#include <memory>
#include <string>

namespace zelqo {

class ServiceClient;

class Account {
 public:
  using SignedUpCb = std::function<void(int error)>;
  using SharingCb = std::function<void(int error, bool on)>;

  /// At the service of the phone's settings when `serviceUrl` is empty. The store outlives this.
  Account(Store& store, std::string msisdn, const std::string& serviceUrl = {});
  ~Account();
  Account(const Account&) = delete;
  Account& operator=(const Account&) = delete;

  /// The number gets a new key, which the store keeps.
  void signUp(const std::string& imsi, const SignedUpCb& done);
  bool signedUp();
  void querySharing(const SharingCb& done);
  void switchSharing(bool on, const SharingCb& done);

 private:
  std::string servicePath() const;

  Store& _store;
  std::string _msisdn;
  std::unique_ptr<ServiceClient> _client;
};

}  // namespace zelqo
