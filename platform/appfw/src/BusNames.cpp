#include <appfw/BusNames.h>
#include <base/Bus.h>

namespace appfw {
namespace {

using common::OwnedVariant;

constexpr std::string_view kPrefix = "phoneapp.i";

/// One question to the bus itself. Null when it refuses.
OwnedVariant askBus(GDBusConnection* bus, const char* method, GVariant* arguments) {
  return base::ask(bus, {"org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
                         method, arguments});
}

common::Owned<const char*, g_free> names(GVariant* answer) {
  if (!answer) return nullptr;
  OwnedVariant list(g_variant_get_child_value(answer, 0));
  // The texts live as long as the answer does.
  return common::Owned<const char*, g_free>(g_variant_get_strv(list.get(), nullptr));
}

bool answeredWith(GVariant* answer, const std::string& name) {
  const auto list = names(answer);
  return list && g_strv_contains(list.get(), name.c_str());
}

bool ownsOrWaitsFor(GDBusConnection* bus, const char* name, const char* sender) {
  return answeredWith(askBus(bus, "ListQueuedOwners", g_variant_new("(s)", name)).get(), sender);
}

std::string escaped(char byte) {
  char text[4];
  g_snprintf(text, sizeof text, "_%02x", static_cast<unsigned char>(byte));
  return text;
}

}  // namespace

std::string busName(const std::string& appId) {
  if (appId.empty()) return {};
  std::string name(kPrefix);
  char before = '\0';
  for (const char c : appId) {
    const bool startsPart = before == '.';
    const bool plain = g_ascii_isalpha(c) || c == '-' || (g_ascii_isdigit(c) && !startsPart) ||
                       (c == '.' && !startsPart);
    name += plain ? std::string(1, c) : escaped(c);
    before = plain ? c : '\0';
  }
  if (before == '.') name.replace(name.size() - 1, 1, escaped('.'));
  return g_dbus_is_name(name.c_str()) ? name : std::string();
}

std::string appIdOfBusName(const std::string& name) {
  if (name.compare(0, kPrefix.size(), kPrefix) != 0) return {};
  std::string id;
  for (size_t i = kPrefix.size(); i < name.size(); i++) {
    if (name[i] != '_') {
      id += name[i];
      continue;
    }
    if (i + 2 >= name.size() || !g_ascii_isxdigit(name[i + 1]) || !g_ascii_isxdigit(name[i + 2])) {
      return {};
    }
    id += static_cast<char>(g_ascii_xdigit_value(name[i + 1]) * 16 +
                            g_ascii_xdigit_value(name[i + 2]));
    i += 2;
  }
  return id;
}

bool isInstalled(GDBusConnection* bus, const std::string& appId) {
  const std::string name = busName(appId);
  if (name.empty()) return false;
  OwnedVariant owned = askBus(bus, "NameHasOwner", g_variant_new("(s)", name.c_str()));
  if (!owned) return true;
  gboolean running = FALSE;
  g_variant_get(owned.get(), "(b)", &running);
  if (running) return true;
  OwnedVariant activatable = askBus(bus, "ListActivatableNames", nullptr);
  return !activatable || answeredWith(activatable.get(), name);
}

Caller findCaller(GDBusConnection* bus, const char* sender) {
  Caller caller;
  OwnedVariant process = askBus(bus, "GetConnectionUnixProcessID", g_variant_new("(s)", sender));
  guint32 pid = 0;
  if (process) g_variant_get(process.get(), "(u)", &pid);
  caller.pid = static_cast<int>(pid);
  OwnedVariant all = askBus(bus, "ListNames", nullptr);
  const auto list = names(all.get());
  for (const char* const* name = list.get(); name && *name; name++) {
    const std::string appId = appIdOfBusName(*name);
    if (!appId.empty() && ownsOrWaitsFor(bus, *name, sender)) caller.appId = appId;
  }
  return caller;
}

bool requestName(GDBusConnection* bus, const std::string& name, unsigned flags) {
  constexpr guint32 primaryOwner = 1, inQueue = 2, alreadyOwner = 4;
  if (name.empty()) return false;
  const guint32 result = base::requestName(bus, name.c_str(), flags);
  return result == primaryOwner || result == inQueue || result == alreadyOwner;
}

void releaseName(GDBusConnection* bus, const std::string& name) {
  askBus(bus, "ReleaseName", g_variant_new("(s)", name.c_str()));
}

}  // namespace appfw
