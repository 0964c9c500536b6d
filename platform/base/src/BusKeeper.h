/// Keeps this process connected with one of the buses.
#pragma once

#include <base/Bus.h>

#include <map>

namespace base {

class BusKeeper {
 public:
  static BusKeeper& of(BusKind kind);

  common::OwnedBus get();
  /// Called on the main loop when the bus is there again.
  unsigned onReturn(std::function<void()> returned);
  void forgetReturn(unsigned id) { _waiting.erase(id); }

 private:
  BusKeeper(GBusType type, const char* name, const char* variable);

  static void closedCb(GDBusConnection* bus, gboolean vanished, GError* error, gpointer self);
  static gboolean seekCb(gpointer self);
  static void foundCb(GObject*, GAsyncResult* result, gpointer self);

  void connect();
  void adopt(common::OwnedBus bus);
  void say(const char* reason);
  void seekLater();
  void tellReturn();
  void lock();
  void unlock();

  const GBusType _type;
  const char* const _name;
  const char* const _variable;
  common::OwnedBus _bus;
  /// Of a bus that takes connections and does not answer them.
  std::string _lockedAddress;
  guint _seeking = 0;
  bool _away = false;
  std::map<unsigned, std::function<void()>> _waiting;
  unsigned _lastWaiting = 0;
};

}  // namespace base
