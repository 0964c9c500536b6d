#include <appfw/BusNames.h>
#include <appfw/CallerName.h>
#include <base/Bus.h>

namespace appfw {

CallerName::CallerName(const std::string& appId) : _bus(base::sessionBus()), _name(busName(appId)) {
  constexpr unsigned allowReplacement = 1;
  _valid = _bus && requestName(_bus.get(), _name, allowReplacement);
}

CallerName::~CallerName() {
  if (!_valid) return;
  base::OwnedVariant answer(g_dbus_connection_call_sync(
      _bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "ReleaseName", g_variant_new("(s)", _name.c_str()), nullptr, G_DBUS_CALL_FLAGS_NONE, 1000,
      nullptr, nullptr));
}

}  // namespace appfw
