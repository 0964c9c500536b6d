#include "FakeThumbnailer.h"

#include "../platform/TestPhone.h"

namespace {

constexpr const char* kXml =
    "<node><interface name='org.freedesktop.thumbnails.Thumbnailer1'><method name='Queue'>"
    "<arg type='as' direction='in'/><arg type='as' direction='in'/><arg type='s' direction='in'/>"
    "<arg type='s' direction='in'/><arg type='u' direction='in'/><arg type='u' direction='out'/>"
    "</method></interface></node>";

}  // namespace

FakeThumbnailer::FakeThumbnailer() : _bus(otherConnection()) {
  static const GDBusInterfaceVTable calls = {_callCb, nullptr, nullptr, {}};
  GDBusNodeInfo* node = g_dbus_node_info_new_for_xml(kXml, nullptr);
  g_dbus_connection_register_object(_bus.get(), "/org/freedesktop/thumbnails/Thumbnailer1",
                                    node->interfaces[0], &calls, this, nullptr, nullptr);
  g_dbus_node_info_unref(node);
  const common::OwnedVariant answer(g_dbus_connection_call_sync(
      _bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "RequestName", g_variant_new("(su)", "org.freedesktop.thumbnails.Thumbnailer1", 4u), nullptr,
      G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
}

FakeThumbnailer::~FakeThumbnailer() {
  g_dbus_connection_close_sync(_bus.get(), nullptr, nullptr);
  settle();
}

void FakeThumbnailer::_callCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                              GVariant* arguments, GDBusMethodInvocation* invocation, void* data) {
  auto* self = static_cast<FakeThumbnailer*>(data);
  self->_calls++;
  common::Owned<GVariantIter, g_variant_iter_free> uris;
  common::Owned<GVariantIter, g_variant_iter_free> types;
  g_variant_get(arguments, "(asas&s&su)", static_cast<GVariantIter**>(common::Out(uris)),
                static_cast<GVariantIter**>(common::Out(types)), nullptr, nullptr, nullptr);
  const char* text = nullptr;
  while (g_variant_iter_next(uris.get(), "&s", &text)) self->_uris.emplace_back(text);
  while (g_variant_iter_next(types.get(), "&s", &text)) self->_types.emplace_back(text);
  g_dbus_method_invocation_return_value(invocation, g_variant_new("(u)", 1u));
}
