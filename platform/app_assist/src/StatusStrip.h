/// The strip along the top of a window: clock, network, battery, latest message. Drawn by the
/// window's layout.
#pragma once

#include <Elementary.h>
#include <vconf.h>

#include <base/Bus.h>
#include <notification/status.h>

#include <memory>
#include <string>

#include "Battery.h"
#include "MessageBanner.h"

namespace app_assist {

class StatusStrip {
 public:
  /// `layout` has the parts "clock", "battery" and "message" and obeys "network,KIND",
  /// "battery,0" (empty) to "battery,5" (full), "battery,none" and "message,show".
  StatusStrip(Evas_Object* window, Evas_Object* layout);
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
  void showBattery(int percent);
  void showMessage(const std::string& text);
  void showNetwork();
  void showNetworkLater();
  void waitForNextMinute();

  Evas_Object* const _layout;
  Ecore_Timer* _minute = nullptr;
  Ecore_Job* _networkJob = nullptr;
  std::unique_ptr<base::SignalSubscription> _networkSignals;
  MessageBanner _banner;
  Battery _battery;
  notification::StatusMessages _messages;
};

}  // namespace app_assist
