/// The phone's buses. A bus that does not answer costs its users a moment, never more: nothing here
/// waits longer than kBusPatience by itself, and whoever was silent once is not waited for again
/// until it has spoken.
#pragma once

#include <common/Owned.h>

#include <chrono>
#include <functional>
#include <string>

namespace base {

enum class BusKind { Session, System };

constexpr std::chrono::milliseconds kBusPatience{500};

/// This process's shared connection; null, with a log line, when the bus cannot be reached. Without
/// its session bus a process ends, as it can be launched by nobody; the system bus may come back.
common::OwnedBus sessionBus();
common::OwnedBus systemBus();

struct Question {
  const char* service;
  const char* path;
  const char* interface;
  const char* method;
  GVariant* arguments = nullptr;  ///< consumed when floating
  const char* answerType = nullptr;
  std::chrono::milliseconds patience = kBusPatience;
};

/// For an answer that is needed before anything else can be done; never starts the service. Null
/// when it refuses or says nothing in time.
common::OwnedVariant ask(GDBusConnection* bus, const Question& question, GError** error = nullptr);

/// What the bus says to a request for a name, with flags as it has them: 1 for a name that is this
/// connection's from now on; 0 when it says nothing.
guint32 requestName(GDBusConnection* bus, const char* name, guint32 flags);
/// Whether this connection has the name from now on; false when it is another's.
bool takeName(GDBusConnection* bus, const char* name);

/// Runs `returned` on the main loop when a bus that was away is there again, each time, until this
/// object goes.
class BusReturn {
 public:
  BusReturn(BusKind kind, std::function<void()> returned);
  ~BusReturn();
  BusReturn(const BusReturn&) = delete;
  BusReturn& operator=(const BusReturn&) = delete;

 private:
  const BusKind _kind;
  const unsigned _id;
};

/// Every signal `interface`.`member` on `path`, from whomever, until this object goes away. Null
/// `member` or `sender` is any. In force when the constructor returns, or when the bus is there.
class SignalSubscription {
 public:
  struct Match {
    const char* sender;
    const char* interface;
    const char* member;
    const char* path;
    std::string arg0{};  ///< empty: any
  };
  /// The texts of `match` live as long as the program.
  SignalSubscription(BusKind kind, const Match& match, GDBusSignalCallback callback, void* data);
  ~SignalSubscription();
  SignalSubscription(const SignalSubscription&) = delete;
  SignalSubscription& operator=(const SignalSubscription&) = delete;

 private:
  void subscribe();
  void unsubscribe();

  const BusKind _kind;
  const Match _match;
  const GDBusSignalCallback _callback;
  void* const _data;
  common::OwnedBus _bus;
  guint _id = 0;
  BusReturn _return;
};

}  // namespace base
