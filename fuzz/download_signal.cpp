// A signal on the system bus, where anybody may send: the member, the type and the bytes of its
// body, each on a line.

#include "Require.h"
#include "Texts.h"
#include "ZQVDownloadSignals.h"
#include "ZQVOwned.h"

#include <gio/gio.h>

#include <cstring>

namespace {

GDBusSignalCallback deliver = nullptr;
gpointer receiver = nullptr;

}  // namespace

// A bus with nothing behind it: what is subscribed to it is called from here.
GDBusConnection* g_bus_get_sync(GBusType, GCancellable*, GError**) {
  return static_cast<GDBusConnection*>(g_object_new(G_TYPE_OBJECT, nullptr));
}
guint g_dbus_connection_signal_subscribe(GDBusConnection*, const gchar*, const gchar*, const gchar*,
                                         const gchar*, const gchar*, GDBusSignalFlags,
                                         GDBusSignalCallback callback, gpointer data,
                                         GDestroyNotify) {
  deliver = callback;
  receiver = data;
  return 1;
}
void g_dbus_connection_signal_unsubscribe(GDBusConnection*, guint) {}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const auto texts = textsOf(data, size, '\n', 3);
  const std::string& member = texts[0];
  const std::string& type = texts[1];
  if (!g_dbus_is_member_name(member.c_str()) || !g_variant_is_signature(type.c_str())) return 0;
  const std::string tuple = "(" + type + ")";
  if (!g_variant_type_string_is_valid(tuple.c_str())) return 0;
  const size_t start = std::min(size, member.size() + type.size() + 2);
  const ZQVOwned<GBytes, g_bytes_unref> bytes(g_bytes_new(data + start, size - start));
  const ZQVOwned<GVariant, g_variant_unref> body(g_variant_ref_sink(g_variant_new_from_bytes(
      reinterpret_cast<const GVariantType*>(tuple.c_str()), bytes.get(), FALSE)));

  ZQVDownloadSignals signals;
  int heard = 0;
  signals.start([&](const char* name, const char* url) {
    ++heard;
    require(strcmp(name, member.c_str()) == 0 && g_utf8_validate(url, -1, nullptr));
    const int status = ZQVDownloadSignals::statusOf(name);
    require(status == 0 || status == 2 || status == 3);
  });
  deliver(nullptr, ":1.7", "/", "i", member.c_str(), body.get(), receiver);
  require(heard == (type == "s"));
  return 0;
}
