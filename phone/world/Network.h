// NetworkManager: which kind of connection the phone has.
#pragma once

#include <string>

#include "BusObject.h"

class Network {
 public:
  explicit Network(GDBusConnection* bus);

  bool publish();
  /// "wifi", "cellular", "ethernet" or "none"; false for anything else.
  bool change(const std::string& kind);

 private:
  BusObject _manager;
  BusObject _connection;
  BusObject _device;
};
