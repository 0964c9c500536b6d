#include "ZQVDownloadSignals.h"

#include <utility>

#include "ZQVLog.h"
#include "ZQVOwned.h"
#include "ZQVThumbItem.h"

namespace {

constexpr const char* kInterface = "org.tizen.call.remote.share";
constexpr const char* kPath = "/com/orlant/remoteshare";
constexpr const char* kDownloading = "file_downloading";
constexpr const char* kDownloaded = "file_downloaded";
constexpr double kReconnectSeconds = 1.0;

}  // namespace

void ZQVDownloadSignals::start(Handler handler) {
  stop();
  _handler = std::move(handler);
  ZQVOwned<GError, g_error_free> error;
  if (!_connect(error.out())) {
    ZQV_ERROR("bus is NULL! errorMessage:[%s]", error ? error->message : "");
  }
}

void ZQVDownloadSignals::stop() {
  _again.stop();
  _disconnect();
}

bool ZQVDownloadSignals::_connect(GError** error) {
  _bus = g_bus_get_sync(G_BUS_TYPE_SYSTEM, nullptr, error);
  if (!_bus) return false;
  // A bus that goes does not take the page with it.
  g_dbus_connection_set_exit_on_close(_bus, FALSE);
  _closed = g_signal_connect(_bus, "closed", G_CALLBACK(_closedCb), this);
  _downloading = _subscribe(kDownloading);
  _downloaded = _subscribe(kDownloaded);
  return true;
}

void ZQVDownloadSignals::_disconnect() {
  _unsubscribe(_downloaded);
  _unsubscribe(_downloading);
  if (_bus) g_clear_signal_handler(&_closed, _bus);
  g_clear_object(&_bus);
}

void ZQVDownloadSignals::_closedCb(GDBusConnection*, gboolean, GError*, gpointer data) {
  auto* signals = static_cast<ZQVDownloadSignals*>(data);
  signals->_again.start(kReconnectSeconds, [signals] { return !signals->_reconnect(); });
}

/// The connection stays the closed one as long as anybody in this process has it.
bool ZQVDownloadSignals::_reconnect() {
  _disconnect();
  return _connect(nullptr) && !g_dbus_connection_is_closed(_bus);
}

int32_t ZQVDownloadSignals::statusOf(const char* member) {
  if (g_strcmp0(member, kDownloading) == 0) return ZQV_DOWNLOADING;
  if (g_strcmp0(member, kDownloaded) == 0) return ZQV_DOWNLOADED;
  return ZQV_NOT_DOWNLOADED;
}

guint ZQVDownloadSignals::_subscribe(const char* member) {
  return g_dbus_connection_signal_subscribe(_bus, nullptr, kInterface, member, kPath, nullptr,
                                            G_DBUS_SIGNAL_FLAGS_NONE, _signalCb, this, nullptr);
}

void ZQVDownloadSignals::_unsubscribe(guint& subscription) {
  if (subscription) g_dbus_connection_signal_unsubscribe(_bus, subscription);
  subscription = 0;
}

void ZQVDownloadSignals::_signalCb(GDBusConnection*, const gchar*, const gchar*, const gchar*,
                                   const gchar* member, GVariant* parameters, gpointer data) {
  if (!data) {
    ZQV_ERROR("user_data is NULL");
    return;
  }
  // Anybody may send on the system bus.
  if (!g_variant_is_of_type(parameters, G_VARIANT_TYPE("(s)"))) {
    ZQV_ERROR("%s with a body of type %s is ignored", member,
              g_variant_get_type_string(parameters));
    return;
  }
  const char* url = nullptr;
  g_variant_get(parameters, "(&s)", &url);
  static_cast<ZQVDownloadSignals*>(data)->_handler(member, url);
}
