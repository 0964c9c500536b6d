#pragma once

#include <Ecore.h>
#include <base/Bus.h>

#include <functional>

namespace history {

/// Tells that the phone's shares may have changed: another process wrote the store, or a share was
/// recalled.
class StoreWatch {
 public:
  /// `onChange` comes once for a burst of changes.
  explicit StoreWatch(std::function<void()> onChange);
  ~StoreWatch();
  StoreWatch(const StoreWatch&) = delete;
  StoreWatch& operator=(const StoreWatch&) = delete;

 private:
  static void _writtenCb(GFileMonitor* monitor, GFile* file, GFile* other, GFileMonitorEvent event,
                         gpointer data);
  static void _recalledCb(GDBusConnection* bus, const char* sender, const char* path,
                          const char* interface, const char* signal, GVariant* arguments,
                          void* data);
  static Eina_Bool _timerCb(void* data);
  void _changed();

  std::function<void()> _onChange;
  common::OwnedObject<GFileMonitor> _monitor;
  base::SignalSubscription _recalled;
  Ecore_Timer* _timer = nullptr;
};

}  // namespace history
