// timedate1: the phone's time zone.
#pragma once

#include "BusObject.h"

class Clock {
 public:
  explicit Clock(GDBusConnection* bus);

  bool publish() { return _object.publish(); }

 private:
  GVariant* _setZone(GVariant* arguments, GError** error);

  BusObject _object;
};
