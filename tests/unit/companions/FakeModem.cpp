#include "FakeModem.h"

#include "../platform/TestPhone.h"

namespace {

constexpr const char* kService = "org.freedesktop.ModemManager1";
constexpr const char* kXml =
    "<node><interface name='org.freedesktop.DBus.ObjectManager'><method name='GetManagedObjects'>"
    "<arg type='a{oa{sa{sv}}}' direction='out'/></method></interface>"
    "<interface name='org.freedesktop.ModemManager1.Sim'>"
    "<property name='Imsi' type='s' access='read'/></interface></node>";

GVariant* managedObjects(bool hasSim) {
  return g_variant_new_parsed(
      "({@o '/org/freedesktop/ModemManager1/Modem/0': "
      "{'org.freedesktop.ModemManager1.Modem': {'Sim': <%o>}}},)",
      hasSim ? "/org/freedesktop/ModemManager1/SIM/0" : "/");
}

GVariant* imsiCb(GDBusConnection*, const char*, const char*, const char*, const char*, GError**,
                 void* data) {
  return g_variant_new_string(static_cast<std::string*>(data)->c_str());
}

void* runLoop(void* loop) {
  g_main_loop_run(static_cast<GMainLoop*>(loop));
  return nullptr;
}

}  // namespace

// Answers from a thread of its own, because the library under test waits for the answer.
FakeModem::FakeModem(const std::string& imsi)
    : _imsi(imsi), _context(g_main_context_new()), _loop(g_main_loop_new(_context, FALSE)) {
  static const GDBusInterfaceVTable manager = {_callCb, nullptr, nullptr, {}};
  static const GDBusInterfaceVTable sim = {nullptr, imsiCb, nullptr, {}};
  g_main_context_push_thread_default(_context);
  _bus = otherConnection();
  GDBusNodeInfo* node = g_dbus_node_info_new_for_xml(kXml, nullptr);
  g_dbus_connection_register_object(_bus.get(), "/org/freedesktop/ModemManager1",
                                    node->interfaces[0], &manager, this, nullptr, nullptr);
  g_dbus_connection_register_object(_bus.get(), "/org/freedesktop/ModemManager1/SIM/0",
                                    node->interfaces[1], &sim, &_imsi, nullptr, nullptr);
  g_dbus_node_info_unref(node);
  g_main_context_pop_thread_default(_context);
  const common::OwnedVariant answer(g_dbus_connection_call_sync(
      _bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "RequestName", g_variant_new("(su)", kService, 4u), nullptr, G_DBUS_CALL_FLAGS_NONE, -1,
      nullptr, nullptr));
  _thread = g_thread_new("modem", runLoop, _loop);
}

FakeModem::~FakeModem() {
  g_dbus_connection_close_sync(_bus.get(), nullptr, nullptr);
  g_main_loop_quit(_loop);
  g_thread_join(_thread);
  g_main_loop_unref(_loop);
  g_main_context_unref(_context);
}

void FakeModem::_callCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                        GVariant*, GDBusMethodInvocation* invocation, void* data) {
  const auto* modem = static_cast<FakeModem*>(data);
  g_dbus_method_invocation_return_value(invocation, managedObjects(!modem->_imsi.empty()));
}
