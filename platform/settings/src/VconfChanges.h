/// Who wants to know of changed keys, in this process.
#pragma once

#include <base/Bus.h>
#include <vconf.h>

#include <memory>
#include <string>
#include <vector>

class VconfChanges {
 public:
  static constexpr const char* kPath = "/phone/Vconf";
  static constexpr const char* kInterface = "phone.Vconf1";
  static constexpr const char* kSignal = "Changed";

  /// Tells every process, this one included.
  static void announce(const std::string& key);

  void add(const std::string& key, vconf_callback_fn callback, void* data);
  bool remove(const std::string& key, vconf_callback_fn callback);

 private:
  struct Listener {
    std::string key;
    vconf_callback_fn callback;
    void* data;
    bool removed = false;
  };

  static void changedCb(GDBusConnection* bus, const char* sender, const char* path,
                        const char* interface, const char* signal, GVariant* arguments, void* data);
  void changed(const std::string& key);

  std::vector<std::shared_ptr<Listener>> _listeners;
  std::unique_ptr<base::SignalSubscription> _subscription;
};
