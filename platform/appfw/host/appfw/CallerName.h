/// Lets a tool launch in an application's name: the receiver sees that application as its caller.
#pragma once

#include <common/Owned.h>

#include <string>

namespace appfw {

class CallerName {
 public:
  /// Queues behind the application when that runs, and steps back when it starts.
  explicit CallerName(const std::string& appId);
  /// Gives the name back. Not before the launch is answered, or the receiver finds nobody.
  ~CallerName();
  CallerName(const CallerName&) = delete;
  CallerName& operator=(const CallerName&) = delete;

  bool isValid() const { return _valid; }

 private:
  common::OwnedBus _bus;
  std::string _name;
  bool _valid = false;
};

}  // namespace appfw
