#pragma once

#include <base/Bus.h>

#include <string>

/// A modem manager on the test's bus with one modem.
class FakeModem {
 public:
  /// Without an identity the modem has no SIM card.
  explicit FakeModem(const std::string& imsi);
  ~FakeModem();
  FakeModem(const FakeModem&) = delete;
  FakeModem& operator=(const FakeModem&) = delete;

 private:
  static void _callCb(GDBusConnection* bus, const char* sender, const char* path,
                      const char* interface, const char* method, GVariant* arguments,
                      GDBusMethodInvocation* invocation, void* data);

  std::string _imsi;
  GThread* _thread;
  GMainContext* _context;
  GMainLoop* _loop;
  common::OwnedBus _bus;
};
