// How the `phone` command changes the world around the phone.
#pragma once

#include "Battery.h"
#include "BusObject.h"
#include "Network.h"
#include "OrientationSensor.h"

class Control {
 public:
  Control(GDBusConnection* bus, Network& network, OrientationSensor& sensor, Battery& battery);

  bool publish() { return _object.publish(); }

 private:
  BusObject _object;
};
