#pragma once

#include <base/Bus.h>

#include <functional>

#include "DownloadManager.h"

namespace downloads {

/// Tells the kind of network, now and whenever it changes.
class NetworkWatch {
 public:
  /// `onChange` is also called once from inside.
  explicit NetworkWatch(std::function<void(Network)> onChange);

 private:
  static void _changedCb(GDBusConnection* bus, const char* sender, const char* path,
                         const char* interface, const char* signal, GVariant* arguments,
                         void* data);
  void _report();

  std::function<void(Network)> _onChange;
  base::SignalSubscription _changed;
};

}  // namespace downloads
