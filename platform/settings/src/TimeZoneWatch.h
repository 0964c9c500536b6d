/// Follows the phone's time zone and makes it this process's own.
#pragma once

#include <base/Bus.h>

#include <functional>
#include <string>

class TimeZoneWatch {
 public:
  /// `onChanged` runs on the main loop, with the new zone in force, and may delete the watch.
  explicit TimeZoneWatch(std::function<void()> onChanged);
  ~TimeZoneWatch();
  TimeZoneWatch(const TimeZoneWatch&) = delete;
  TimeZoneWatch& operator=(const TimeZoneWatch&) = delete;

  /// The zone in force, such as "Europe/Berlin".
  static std::string current();

 private:
  static void changedCb(GDBusConnection* bus, const char* sender, const char* path,
                        const char* interface, const char* signal, GVariant* arguments, void* data);
  static void answeredCb(GObject* bus, GAsyncResult* result, void* data);

  void ask();
  void apply(const std::string& zone);

  std::function<void()> _onChanged;
  common::OwnedObject<GCancellable> _asking{g_cancellable_new()};
  base::SignalSubscription _subscription;
  base::BusReturn _busReturn;
};
