#include "Battery.h"

#include <dlog.h>

namespace app_assist {
namespace {

constexpr const char* kService = "org.freedesktop.UPower";
constexpr const char* kPath = "/org/freedesktop/UPower/devices/DisplayDevice";
constexpr const char* kInterface = "org.freedesktop.UPower.Device";

common::OwnedVariant property(GDBusProxy* proxy, const char* name, const GVariantType* type) {
  common::OwnedVariant value(g_dbus_proxy_get_cached_property(proxy, name));
  if (value && !g_variant_is_of_type(value.get(), type)) value.reset();
  return value;
}

}  // namespace

Battery::Battery(std::function<void(int)> changed)
    : _changed(std::move(changed)),
      _cancellable(g_cancellable_new()),
      _busReturn(base::BusKind::System, [this] { connect(); }) {
  connect();
}

Battery::~Battery() {
  g_cancellable_cancel(_cancellable);
  g_object_unref(_cancellable);
  dropProxy();
}

/// Over the keeper's connection: another thread that joins a silent bus would hold up everybody.
void Battery::connect() {
  dropProxy();
  const common::OwnedBus bus = base::systemBus();
  if (!bus) return;
  g_dbus_proxy_new(bus.get(), G_DBUS_PROXY_FLAGS_NONE, nullptr, kService, kPath, kInterface,
                   _cancellable, proxyReadyCb, this);
}

void Battery::dropProxy() {
  if (!_proxy) return;
  g_signal_handlers_disconnect_by_data(_proxy, this);
  g_clear_object(&_proxy);
}

/// A cancelled call comes back after this object is gone, so the result is looked at first.
void Battery::proxyReadyCb(GObject*, GAsyncResult* result, void* data) {
  GError* error = nullptr;
  GDBusProxy* proxy = g_dbus_proxy_new_finish(result, &error);
  const common::OwnedError owned(error);
  if (proxy) {
    static_cast<Battery*>(data)->setProxy(proxy);
  } else if (!g_error_matches(error, G_IO_ERROR, G_IO_ERROR_CANCELLED)) {
    dlog_print(DLOG_WARN, "APP_ASSIST", "no power service: %s", error->message);
  }
}

void Battery::setProxy(GDBusProxy* proxy) {
  dropProxy();
  _proxy = proxy;
  g_signal_connect(proxy, "g-properties-changed", G_CALLBACK(propertiesChangedCb), this);
  report();
}

void Battery::report() {
  const common::OwnedVariant present = property(_proxy, "IsPresent", G_VARIANT_TYPE_BOOLEAN);
  const common::OwnedVariant charge = property(_proxy, "Percentage", G_VARIANT_TYPE_DOUBLE);
  const bool known = present && g_variant_get_boolean(present.get()) && charge;
  _changed(known ? static_cast<int>(g_variant_get_double(charge.get())) : -1);
}

void Battery::propertiesChangedCb(GDBusProxy*, GVariant*, const char* const*, void* data) {
  static_cast<Battery*>(data)->report();
}

}  // namespace app_assist
