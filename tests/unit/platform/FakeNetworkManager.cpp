#include "FakeNetworkManager.h"

#include "TestPhone.h"

FakeNetworkManager::FakeNetworkManager() : _bus(otherConnection()) {
  g_dbus_connection_add_filter(_bus.get(), filterCb, this, nullptr);
  common::OwnedVariant answer(g_dbus_connection_call_sync(
      _bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "RequestName", g_variant_new("(su)", "org.freedesktop.NetworkManager", 0u), nullptr,
      G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
}

FakeNetworkManager::~FakeNetworkManager() {
  g_dbus_connection_close_sync(_bus.get(), nullptr, nullptr);
}

void FakeNetworkManager::set(const std::string& path, const std::string& properties) {
  _objects[path] = properties;
}

void FakeNetworkManager::fallSilent() {
  _silent = true;
}

GDBusMessage* FakeNetworkManager::filterCb(GDBusConnection* bus, GDBusMessage* message,
                                           gboolean incoming, void* data) {
  auto* self = static_cast<FakeNetworkManager*>(data);
  const char* member = g_dbus_message_get_member(message);
  if (!incoming || !member || std::string(member) != "GetAll") return message;
  if (!self->_silent) {
    common::OwnedMessage answer(self->answer(message));
    g_dbus_connection_send_message(bus, answer.get(), G_DBUS_SEND_MESSAGE_FLAGS_NONE, nullptr,
                                   nullptr);
  }
  g_object_unref(message);
  return nullptr;
}

GDBusMessage* FakeNetworkManager::answer(GDBusMessage* question) {
  const auto object = _objects.find(g_dbus_message_get_path(question));
  if (object == _objects.end()) {
    return g_dbus_message_new_method_error_literal(question, "test.NoSuchObject", "none");
  }
  GDBusMessage* answer = g_dbus_message_new_method_reply(question);
  GVariant* properties =
      g_variant_parse(G_VARIANT_TYPE_VARDICT, object->second.c_str(), nullptr, nullptr, nullptr);
  g_dbus_message_set_body(answer, g_variant_new("(@a{sv})", properties));
  return answer;
}
