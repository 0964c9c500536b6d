/// The network service: answers on the connection's own thread, since who asks for the network type
/// waits.
#pragma once

#include <common/Owned.h>

#include <map>
#include <string>

class FakeNetworkManager {
 public:
  FakeNetworkManager();
  ~FakeNetworkManager();
  FakeNetworkManager(const FakeNetworkManager&) = delete;
  FakeNetworkManager& operator=(const FakeNetworkManager&) = delete;

  /// "{'Name': <value>, …}" as the answer for an object.
  void set(const std::string& path, const std::string& properties);
  /// Lets every question wait in vain.
  void fallSilent();

  static constexpr const char* kManager = "/org/freedesktop/NetworkManager";

 private:
  static GDBusMessage* filterCb(GDBusConnection* bus, GDBusMessage* message, gboolean incoming,
                                void* data);
  GDBusMessage* answer(GDBusMessage* question);

  common::OwnedBus _bus;
  std::map<std::string, std::string> _objects;
  bool _silent = false;
};
