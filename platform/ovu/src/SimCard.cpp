#include "SimCard.h"

#include <base/Bus.h>

namespace ovu {
namespace {

constexpr const char* kService = "org.freedesktop.ModemManager1";
constexpr const char* kModem = "org.freedesktop.ModemManager1.Modem";
constexpr const char* kSim = "org.freedesktop.ModemManager1.Sim";

using common::OwnedVariant;

OwnedVariant call(GDBusConnection* bus, const char* path, const char* interface, const char* method,
                  GVariant* arguments, const char* replyType) {
  return base::ask(bus, {kService, path, interface, method, arguments, replyType});
}

std::string firstSimPath(GVariant* objects) {
  GVariantIter iter;
  g_variant_iter_init(&iter, objects);
  GVariant* raw = nullptr;
  while (g_variant_iter_loop(&iter, "{&o@a{sa{sv}}}", nullptr, &raw)) {
    const OwnedVariant modem(g_variant_lookup_value(raw, kModem, G_VARIANT_TYPE_VARDICT));
    const char* sim = nullptr;
    if (modem && g_variant_lookup(modem.get(), "Sim", "&o", &sim) && std::string("/") != sim) {
      const std::string path = sim;
      g_variant_unref(raw);
      return path;
    }
  }
  return {};
}

}  // namespace

std::string simCardImsi() {
  const common::OwnedBus bus = base::systemBus();
  if (!bus) return {};
  const auto managed =
      call(bus.get(), "/org/freedesktop/ModemManager1", "org.freedesktop.DBus.ObjectManager",
           "GetManagedObjects", nullptr, "(a{oa{sa{sv}}})");
  if (!managed) return {};
  const OwnedVariant objects(g_variant_get_child_value(managed.get(), 0));
  const std::string sim = firstSimPath(objects.get());
  if (sim.empty()) return {};
  // The identity is not among the managed properties: it has to be asked for.
  const auto answer = call(bus.get(), sim.c_str(), "org.freedesktop.DBus.Properties", "Get",
                           g_variant_new("(ss)", kSim, "Imsi"), "(v)");
  if (!answer) return {};
  GVariant* raw = nullptr;
  g_variant_get(answer.get(), "(v)", &raw);
  const OwnedVariant imsi(raw);
  return g_variant_is_of_type(raw, G_VARIANT_TYPE_STRING) ? g_variant_get_string(raw, nullptr) : "";
}

}  // namespace ovu
