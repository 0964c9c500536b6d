// How the `phone` command changes the world around the phone.
#pragma once

#include "BusObject.h"
#include "Network.h"
#include "OrientationSensor.h"

class Control {
 public:
  Control(GDBusConnection* bus, Network& network, OrientationSensor& sensor);

  bool publish() { return _object.publish(); }

 private:
  BusObject _object;
};
