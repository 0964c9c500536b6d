/// Follows the messages for the status bar: whoever posts one, every status bar shows it.
#pragma once

#include <base/Bus.h>

#include <functional>
#include <string>

namespace notification {

class StatusMessages {
 public:
  /// `onMessage` gets the plain text, on the main loop.
  explicit StatusMessages(std::function<void(const std::string&)> onMessage);

 private:
  static void postedCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                       GVariant* arguments, void* data);

  const std::function<void(const std::string&)> _onMessage;
  base::SignalSubscription _posted;
};

}  // namespace notification
