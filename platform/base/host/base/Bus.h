/// The phone's buses.
#pragma once

#include <common/Owned.h>

#include <string>

namespace base {

/// This process's shared connection; null, with a log line, when the bus cannot be reached.
common::OwnedBus sessionBus();
common::OwnedBus systemBus();

/// Every signal `interface`.`member` on `path`, from whomever, until this object goes away. Null
/// `member` or `sender` is any. In force when the constructor returns.
class SignalSubscription {
 public:
  struct Match {
    const char* sender;
    const char* interface;
    const char* member;
    const char* path;
    const char* arg0 = nullptr;
  };
  SignalSubscription(common::OwnedBus bus, const Match& match, GDBusSignalCallback callback,
                     void* data);
  ~SignalSubscription();
  SignalSubscription(const SignalSubscription&) = delete;
  SignalSubscription& operator=(const SignalSubscription&) = delete;

 private:
  common::OwnedBus _bus;
  guint _id = 0;
};

}  // namespace base
