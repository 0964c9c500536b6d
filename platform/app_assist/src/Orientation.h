/// How the phone is held, as its orientation sensor says.
#pragma once

#include <base/Bus.h>

#include <functional>

namespace app_assist {

class Orientation {
 public:
  /// `changed` gets 0, 90, 180 or 270 from the main loop, at first when the sensor has answered.
  /// Without a sensor it is never called.
  explicit Orientation(std::function<void(int degrees)> changed);
  ~Orientation();
  Orientation(const Orientation&) = delete;
  Orientation& operator=(const Orientation&) = delete;

 private:
  static void proxyReadyCb(GObject*, GAsyncResult* result, void* data);
  static void ownerChangedCb(GObject*, GParamSpec*, void* data);
  static void propertiesChangedCb(GDBusProxy*, GVariant*, const char* const*, void* data);
  static void claimedCb(GObject* proxy, GAsyncResult* result, void* data);

  void connect();
  void dropProxy();
  void setProxy(GDBusProxy* proxy);
  void claim();
  void report();

  std::function<void(int)> _changed;
  GCancellable* _cancellable;
  GDBusProxy* _proxy = nullptr;
  base::BusReturn _busReturn;
};

}  // namespace app_assist
