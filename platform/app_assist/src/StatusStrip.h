/// The strip along the top of a window: clock, network, battery. Drawn by the window's layout.
#pragma once

#include <Elementary.h>
#include <vconf.h>

#include <base/Bus.h>

#include <memory>

namespace app_assist {

class StatusStrip {
 public:
  /// `layout` has the parts "clock" and "battery" and obeys "network,KIND" and "battery,show/hide".
  explicit StatusStrip(Evas_Object* layout);
  ~StatusStrip();
  StatusStrip(const StatusStrip&) = delete;
  StatusStrip& operator=(const StatusStrip&) = delete;

 private:
  static Eina_Bool minuteCb(void* data);
  static void networkJobCb(void* data);
  static void clockFormatCb(keynode_t*, void* data);
  static void networkSignalCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                              GVariant*, void* data);

  void showClock();
  void showBattery();
  void showNetwork();
  void showNetworkLater();
  void waitForNextMinute();

  Evas_Object* const _layout;
  Ecore_Timer* _minute = nullptr;
  Ecore_Job* _networkJob = nullptr;
  std::unique_ptr<base::SignalSubscription> _networkSignals;
};

}  // namespace app_assist
