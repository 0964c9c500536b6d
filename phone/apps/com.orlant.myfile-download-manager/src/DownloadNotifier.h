#pragma once

#include <base/Bus.h>

#include <functional>
#include <map>
#include <string>

namespace downloads {

/// Notifications that do something when they are tapped.
class DownloadNotifier {
 public:
  DownloadNotifier();

  void post(const std::string& message, std::function<void()> onTap);

 private:
  struct Posted;

  static void _postedCb(GObject* bus, GAsyncResult* result, gpointer data);
  static void _invokedCb(GDBusConnection* bus, const char* sender, const char* path,
                         const char* interface, const char* signal, GVariant* arguments,
                         void* data);

  common::OwnedBus _bus;
  std::map<unsigned int, std::function<void()>> _handlers;
  base::SignalSubscription _invoked;
};

}  // namespace downloads
