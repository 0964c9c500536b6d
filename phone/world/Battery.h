// UPower: the charge of the battery.
#pragma once

#include "BusObject.h"

class Battery {
 public:
  explicit Battery(GDBusConnection* bus);

  bool publish() { return _device.publish(); }
  /// Percent; false for what is no share of a hundred.
  bool charge(int percent);

 private:
  BusObject _device;
};
