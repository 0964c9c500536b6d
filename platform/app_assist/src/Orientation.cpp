#include "Orientation.h"

#include <dlog.h>

#include <common/Owned.h>

#include <cstring>

namespace app_assist {
namespace {

constexpr const char* kService = "net.hadess.SensorProxy";
constexpr const char* kPath = "/net/hadess/SensorProxy";
constexpr const char* kProperty = "AccelerometerOrientation";

/// Degrees by the side of the phone that is up; -1 while it lies flat.
int degreesOf(const char* orientation) {
  static const struct {
    const char* name;
    int degrees;
  } kSides[] = {{"normal", 0}, {"left-up", 90}, {"bottom-up", 180}, {"right-up", 270}};
  for (const auto& side : kSides) {
    if (strcmp(side.name, orientation) == 0) return side.degrees;
  }
  return -1;
}

}  // namespace

Orientation::Orientation(std::function<void(int)> changed)
    : _changed(std::move(changed)),
      _cancellable(g_cancellable_new()),
      _busReturn(base::BusKind::System, [this] { connect(); }) {
  connect();
}

Orientation::~Orientation() {
  g_cancellable_cancel(_cancellable);
  g_object_unref(_cancellable);
  dropProxy();
}

void Orientation::connect() {
  dropProxy();
  const common::OwnedBus bus = base::systemBus();
  if (!bus) return;
  g_dbus_proxy_new(bus.get(), G_DBUS_PROXY_FLAGS_DO_NOT_AUTO_START, nullptr, kService, kPath,
                   kService, _cancellable, proxyReadyCb, this);
}

void Orientation::dropProxy() {
  if (!_proxy) return;
  g_signal_handlers_disconnect_by_data(_proxy, this);
  g_clear_object(&_proxy);
}

/// A cancelled call comes back after this object is gone, so the result is looked at first.
void Orientation::proxyReadyCb(GObject*, GAsyncResult* result, void* data) {
  GError* error = nullptr;
  GDBusProxy* proxy = g_dbus_proxy_new_finish(result, &error);
  const common::OwnedError owned(error);
  if (proxy) {
    static_cast<Orientation*>(data)->setProxy(proxy);
  } else if (!g_error_matches(error, G_IO_ERROR, G_IO_ERROR_CANCELLED)) {
    dlog_print(DLOG_WARN, "APP_ASSIST", "no orientation sensor: %s", error->message);
  }
}

void Orientation::setProxy(GDBusProxy* proxy) {
  dropProxy();
  _proxy = proxy;
  g_signal_connect(proxy, "notify::g-name-owner", G_CALLBACK(ownerChangedCb), this);
  g_signal_connect(proxy, "g-properties-changed", G_CALLBACK(propertiesChangedCb), this);
  claim();
}

/// The sensor reports only to those who claimed it, and a new one knows of no claims.
void Orientation::claim() {
  const common::OwnedText owner(g_dbus_proxy_get_name_owner(_proxy));
  if (!owner) return;
  g_dbus_proxy_call(_proxy, "ClaimAccelerometer", nullptr, G_DBUS_CALL_FLAGS_NO_AUTO_START, -1,
                    _cancellable, claimedCb, this);
}

void Orientation::claimedCb(GObject* proxy, GAsyncResult* result, void* data) {
  GError* error = nullptr;
  const common::OwnedVariant answer(
      g_dbus_proxy_call_finish(reinterpret_cast<GDBusProxy*>(proxy), result, &error));
  const common::OwnedError owned(error);
  if (answer) {
    static_cast<Orientation*>(data)->report();
  } else if (!g_error_matches(error, G_IO_ERROR, G_IO_ERROR_CANCELLED)) {
    dlog_print(DLOG_WARN, "APP_ASSIST", "the orientation sensor refused: %s", error->message);
  }
}

void Orientation::report() {
  const common::OwnedVariant value(g_dbus_proxy_get_cached_property(_proxy, kProperty));
  if (!value || !g_variant_is_of_type(value.get(), G_VARIANT_TYPE_STRING)) return;
  const int degrees = degreesOf(g_variant_get_string(value.get(), nullptr));
  if (degrees >= 0) _changed(degrees);
}

void Orientation::ownerChangedCb(GObject*, GParamSpec*, void* data) {
  static_cast<Orientation*>(data)->claim();
}

void Orientation::propertiesChangedCb(GDBusProxy*, GVariant*, const char* const*, void* data) {
  static_cast<Orientation*>(data)->report();
}

}  // namespace app_assist
