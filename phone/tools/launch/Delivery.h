// Watches one launch request on its way: the caller of a launch is not told whether it arrived.
#pragma once

#include <common/Owned.h>

#include <condition_variable>
#include <mutex>
#include <string>

class Delivery {
 public:
  /// Make it before the launch; it watches this process's session bus.
  explicit Delivery(GDBusConnection* bus);
  ~Delivery();
  Delivery(const Delivery&) = delete;
  Delivery& operator=(const Delivery&) = delete;

  /// Waits until the application has taken the request. False, with the reason, when it did not.
  bool wait(std::string& reason);

 private:
  static GDBusMessage* _filterCb(GDBusConnection*, GDBusMessage* message, gboolean incoming,
                                 gpointer self);
  void _see(GDBusMessage* message, bool incoming);

  GDBusConnection* const _bus;
  guint _filter;
  std::mutex _mutex;
  std::condition_variable _changed;
  guint32 _serial = 0;
  bool _answered = false;
  std::string _reason;
};
