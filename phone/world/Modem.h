// ModemManager: the phone's modem and its SIM card.
#pragma once

#include <string>

#include "BusObject.h"

class Modem {
 public:
  /// The subscriber's number goes onto the SIM card.
  Modem(GDBusConnection* bus, const std::string& number);

  bool publish();

 private:
  GVariant* _managedObjects() const;

  BusObject _manager;
  BusObject _modem;
  BusObject _card;
};
