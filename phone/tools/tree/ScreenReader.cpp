#include "ScreenReader.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <cstdio>
#include <string>

using common::Out;
using common::OwnedBus;
using common::OwnedError;
using common::OwnedText;
using common::OwnedVariant;

namespace {

constexpr const char* kName = "org.a11y.Bus";
constexpr const char* kPath = "/org/a11y/bus";
constexpr const char* kProperties = "org.freedesktop.DBus.Properties";
constexpr const char* kStatus = "org.a11y.Status";
constexpr const char* kEnabled = "ScreenReaderEnabled";

int takeTurn() {
  const std::string path = std::string(g_get_user_runtime_dir()) + "/screen-reader.lock";
  const int file = open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0600);
  if (file >= 0) flock(file, LOCK_EX);
  return file;
}

}  // namespace

ScreenReader::ScreenReader(GDBusConnection* sessionBus)
    : _bus(sessionBus), _turn(takeTurn()), _wasOn(_isOn()) {
  if (!_wasOn) _set(true);
}

ScreenReader::~ScreenReader() {
  if (!_wasOn) _set(false);
  if (_turn >= 0) close(_turn);
}

bool ScreenReader::_isOn() const {
  const OwnedVariant answer(g_dbus_connection_call_sync(
      _bus, kName, kPath, kProperties, "Get", g_variant_new("(ss)", kStatus, kEnabled),
      G_VARIANT_TYPE("(v)"), G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
  if (!answer) return false;
  OwnedVariant value;
  g_variant_get(answer.get(), "(v)", static_cast<GVariant**>(Out(value)));
  return g_variant_is_of_type(value.get(), G_VARIANT_TYPE_BOOLEAN) &&
         g_variant_get_boolean(value.get());
}

void ScreenReader::_set(bool on) {
  const OwnedVariant answer(g_dbus_connection_call_sync(
      _bus, kName, kPath, kProperties, "Set",
      g_variant_new("(ssv)", kStatus, kEnabled, g_variant_new_boolean(on)), nullptr,
      G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
}

OwnedBus ScreenReader::connect() const {
  OwnedError error;
  const OwnedVariant answer(g_dbus_connection_call_sync(
      _bus, kName, kPath, kName, "GetAddress", nullptr, G_VARIANT_TYPE("(s)"),
      G_DBUS_CALL_FLAGS_NONE, -1, nullptr, Out(error)));
  OwnedBus bus;
  if (answer) {
    OwnedText address;
    g_variant_get(answer.get(), "(s)", static_cast<char**>(Out(address)));
    const auto flags =
        static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                          G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION);
    bus.reset(
        g_dbus_connection_new_for_address_sync(address.get(), flags, nullptr, nullptr, Out(error)));
  }
  if (error) fprintf(stderr, "phone-tree: no accessibility bus: %s\n", error->message);
  return bus;
}
