#include "BusObject.h"

using common::Out;
using common::OwnedError;
using common::OwnedVariant;

BusObject::BusObject(GDBusConnection* bus, std::string path, const char* xml)
    : _bus(bus), _path(std::move(path)), _info(g_dbus_node_info_new_for_xml(xml, nullptr)) {}

BusObject::~BusObject() {
  withdraw();
}

const char* BusObject::interface() const {
  return _info->interfaces[0]->name;
}

bool BusObject::publish() {
  if (_registration) return true;
  static const GDBusInterfaceVTable kCalls = {_method, _property, nullptr, {}};
  OwnedError error;
  _registration = g_dbus_connection_register_object(_bus, _path.c_str(), _info->interfaces[0],
                                                    &kCalls, this, nullptr, Out(error));
  if (error) g_printerr("phone-world: %s: %s\n", _path.c_str(), error->message);
  return _registration != 0;
}

void BusObject::withdraw() {
  if (_registration) g_dbus_connection_unregister_object(_bus, _registration);
  _registration = 0;
}

void BusObject::tellOnly(std::function<void(const std::function<void(const char*)>&)> listeners) {
  _listeners = std::move(listeners);
}

void BusObject::set(const std::string& property, GVariant* value) {
  OwnedVariant owned(g_variant_ref_sink(value));
  const auto before = _values.find(property);
  const bool same = before != _values.end() && g_variant_equal(before->second.get(), value);
  _values[property] = std::move(owned);
  if (same || !_registration) return;
  if (_listeners) {
    _listeners([&](const char* listener) { _tell(listener, property, value); });
  } else {
    _tell(nullptr, property, value);
  }
}

void BusObject::_tell(const char* destination, const std::string& property, GVariant* value) {
  GVariantBuilder changed;
  g_variant_builder_init(&changed, G_VARIANT_TYPE_VARDICT);
  g_variant_builder_add(&changed, "{sv}", property.c_str(), value);
  g_dbus_connection_emit_signal(
      _bus, destination, _path.c_str(), "org.freedesktop.DBus.Properties", "PropertiesChanged",
      g_variant_new("(sa{sv}as)", interface(), &changed, nullptr), nullptr);
}

GVariant* BusObject::get(const std::string& property) const {
  const auto found = _values.find(property);
  return found == _values.end() ? nullptr : found->second.get();
}

GVariant* BusObject::properties() const {
  GVariantBuilder all;
  g_variant_builder_init(&all, G_VARIANT_TYPE_VARDICT);
  for (const auto& [name, value] : _values) {
    g_variant_builder_add(&all, "{sv}", name.c_str(), value.get());
  }
  return g_variant_builder_end(&all);
}

void BusObject::emit(const char* signal, GVariant* arguments) {
  g_dbus_connection_emit_signal(_bus, nullptr, _path.c_str(), interface(), signal, arguments,
                                nullptr);
}

void BusObject::_method(GDBusConnection*, const char* sender, const char*, const char*,
                        const char* name, GVariant* arguments, GDBusMethodInvocation* invocation,
                        gpointer self) {
  const auto& methods = static_cast<BusObject*>(self)->_methods;
  const auto method = methods.find(name);
  if (method == methods.end()) {
    g_dbus_method_invocation_return_error(invocation, G_DBUS_ERROR, G_DBUS_ERROR_NOT_SUPPORTED,
                                          "%s does nothing on this phone", name);
    return;
  }
  GError* error = nullptr;
  GVariant* answer = method->second(arguments, sender ? sender : "", &error);
  if (error) {
    g_dbus_method_invocation_take_error(invocation, error);
  } else {
    g_dbus_method_invocation_return_value(invocation, answer);
  }
}

GVariant* BusObject::_property(GDBusConnection*, const char*, const char*, const char*,
                               const char* name, GError** error, gpointer self) {
  GVariant* value = static_cast<BusObject*>(self)->get(name);
  if (value) return g_variant_ref(value);
  g_set_error(error, G_DBUS_ERROR, G_DBUS_ERROR_UNKNOWN_PROPERTY, "%s is not known", name);
  return nullptr;
}
