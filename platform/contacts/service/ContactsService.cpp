#include "ContactsService.h"

#include <dlog.h>

namespace contacts {
namespace {

using common::Out;
using common::OwnedError;
using common::OwnedVariant;

GDBusInterfaceInfo* serviceInterface() {
  static GDBusNodeInfo* node = g_dbus_node_info_new_for_xml(
      "<node><interface name='phone.Contacts1'>"
      "<method name='GetAll'><arg type='a(issasb)' direction='out'/></method>"
      "<signal name='Changed'/>"
      "</interface></node>",
      nullptr);
  return node->interfaces[0];
}

}  // namespace

ContactsService::ContactsService(GDBusConnection* bus)
    : _bus(bus), _book([this] { _tellChange(); }) {}

ContactsService::~ContactsService() {
  if (_object) g_dbus_connection_unregister_object(_bus, _object);
}

bool ContactsService::start() {
  static const GDBusInterfaceVTable calls = {_methodCb, nullptr, nullptr, {}};
  _book.open();
  OwnedError error;
  _object = g_dbus_connection_register_object(_bus, kServicePath, serviceInterface(), &calls, this,
                                              nullptr, Out(error));
  if (!_object || !_takeName()) {
    dlog_print(DLOG_ERROR, "CONTACTS", "the contacts service cannot be reached by others");
    return false;
  }
  // Whoever knew the service before it ended knows less than it does now.
  _tellChange();
  return true;
}

bool ContactsService::_takeName() {
  constexpr guint doNotQueue = 4;
  constexpr guint owner = 1;
  const OwnedVariant answer(g_dbus_connection_call_sync(
      _bus, "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus", "RequestName",
      g_variant_new("(su)", kServiceName, doNotQueue), G_VARIANT_TYPE("(u)"),
      G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
  guint result = 0;
  if (answer) g_variant_get(answer.get(), "(u)", &result);
  return result == owner;
}

void ContactsService::_tellChange() {
  g_dbus_connection_emit_signal(_bus, nullptr, kServicePath, kServiceInterface, "Changed", nullptr,
                                nullptr);
}

void ContactsService::_methodCb(GDBusConnection*, const char*, const char*, const char*,
                                const char*, GVariant*, GDBusMethodInvocation* invocation,
                                gpointer data) {
  const auto* self = static_cast<ContactsService*>(data);
  std::vector<Person> persons;
  for (const auto& entry : self->_book.persons()) persons.push_back(entry.second);
  g_dbus_method_invocation_return_value(invocation, toVariant(persons));
}

}  // namespace contacts
