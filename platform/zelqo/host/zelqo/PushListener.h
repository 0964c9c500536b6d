/// Keeps the store up to date with what the sharing service tells a number.
#pragma once

#include <zelqo/Push.h>
#include <zelqo/Store.h>

#include <functional>
#include <memory>
#include <string>

namespace zelqo {

class Account;
class ServiceClient;

class PushListener {
 public:
  /// The store outlives this.
  PushListener(Store& store, std::string msisdn, const std::string& serviceUrl);
  ~PushListener();
  PushListener(const PushListener&) = delete;
  PushListener& operator=(const PushListener&) = delete;

  /// Signs the number up where needed and listens until the object goes away; a service that is
  /// away is tried again at least once a second. `settled` runs once, when the service listens to
  /// this number, or has turned out to be away.
  void start(std::function<void()> settled);

 private:
  static int retryCb(void* self);
  void proceed();
  void signUp();
  void poll();
  void take(const Push& push);
  bool record(const PushEvent& event);
  bool skipTo(const std::string& cursor);
  void tryAgain();
  void settle();

  Store& _store;
  std::string _msisdn;
  std::unique_ptr<ServiceClient> _client;
  std::unique_ptr<Account> _account;
  std::function<void()> _settled;
  unsigned int _pauseMs;
  unsigned int _retry = 0;
};

}  // namespace zelqo
