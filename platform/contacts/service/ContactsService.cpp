#include "ContactsService.h"

#include <base/Bus.h>
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
  if (!_object || !base::takeName(_bus, kServiceName)) {
    dlog_print(DLOG_ERROR, "CONTACTS", "the contacts service cannot be reached by others");
    return false;
  }
  // Whoever knew the service before it ended knows less than it does now.
  _tellChange();
  return true;
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
