// net.hadess.SensorProxy: which edge of the phone is up.
#pragma once

#include <map>
#include <string>

#include "BusObject.h"

class OrientationSensor {
 public:
  explicit OrientationSensor(GDBusConnection* bus);
  ~OrientationSensor();
  OrientationSensor(const OrientationSensor&) = delete;
  OrientationSensor& operator=(const OrientationSensor&) = delete;

  bool publish() { return _object.publish(); }
  /// 0, 90, 180 or 270 degrees, as the picture on the screen turns; false for anything else.
  bool turn(int degrees);

 private:
  static void _clientGone(GDBusConnection*, const char* client, gpointer self);

  BusObject _object;
  GDBusConnection* const _bus;
  std::map<std::string, guint> _clients;  // those that claimed the sensor, and the watch on each
};
