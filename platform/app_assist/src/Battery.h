/// The charge of the battery, as the power service tells it.
#pragma once

#include <base/Bus.h>

#include <functional>

namespace app_assist {

class Battery {
 public:
  /// `changed` gets percent, or -1 when there is no battery, at once when it is known and whenever
  /// it changes.
  explicit Battery(std::function<void(int percent)> changed);
  ~Battery();
  Battery(const Battery&) = delete;
  Battery& operator=(const Battery&) = delete;

 private:
  static void proxyReadyCb(GObject*, GAsyncResult* result, void* data);
  static void propertiesChangedCb(GDBusProxy*, GVariant*, const char* const*, void* data);

  void connect();
  void dropProxy();
  void setProxy(GDBusProxy* proxy);
  void report();

  const std::function<void(int)> _changed;
  GCancellable* const _cancellable;
  GDBusProxy* _proxy = nullptr;
  const base::BusReturn _busReturn;
};

}  // namespace app_assist
