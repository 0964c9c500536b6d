#include "ThumbnailQueue.h"

#include <gio/gio.h>

#include <memory>
#include <unordered_set>
#include <vector>

namespace media {
namespace {

constexpr int kTimeoutMs = 10000;

struct Request {
  std::string uri;
  std::string mimeType;
};

class ThumbnailQueue {
 public:
  void add(const std::string& path, const std::string& mimeType) {
    // A file without a picture leaves no trace in the cache: without this memory every look at it
    // would ask again.
    if (!_asked.insert(path).second) return;
    const std::unique_ptr<char, void (*)(void*)> uri(
        g_filename_to_uri(path.c_str(), nullptr, nullptr), g_free);
    if (!uri) return;
    if (_pending.empty()) g_idle_add(_sendCb, this);
    _pending.push_back({uri.get(), mimeType});
  }

 private:
  static gboolean _sendCb(gpointer data) {
    static_cast<ThumbnailQueue*>(data)->_send();
    return G_SOURCE_REMOVE;
  }

  void _send() {
    GVariantBuilder uris;
    GVariantBuilder types;
    g_variant_builder_init(&uris, G_VARIANT_TYPE_STRING_ARRAY);
    g_variant_builder_init(&types, G_VARIANT_TYPE_STRING_ARRAY);
    for (const auto& request : _pending) {
      g_variant_builder_add(&uris, "s", request.uri.c_str());
      g_variant_builder_add(&types, "s", request.mimeType.c_str());
    }
    _pending.clear();
    GVariant* arguments =
        g_variant_ref_sink(g_variant_new("(asasssu)", &uris, &types, "large", "foreground", 0u));
    if (GDBusConnection* bus = g_bus_get_sync(G_BUS_TYPE_SESSION, nullptr, nullptr)) {
      g_dbus_connection_call(bus, "org.freedesktop.thumbnails.Thumbnailer1",
                             "/org/freedesktop/thumbnails/Thumbnailer1",
                             "org.freedesktop.thumbnails.Thumbnailer1", "Queue", arguments, nullptr,
                             G_DBUS_CALL_FLAGS_NONE, kTimeoutMs, nullptr, nullptr, nullptr);
      g_object_unref(bus);
    }
    g_variant_unref(arguments);
  }

  std::unordered_set<std::string> _asked;
  std::vector<Request> _pending;
};

}  // namespace

void queueThumbnail(const std::string& path, const std::string& mimeType) {
  static auto* queue = new ThumbnailQueue;  // lives as long as the main loop may call it
  queue->add(path, mimeType);
}

}  // namespace media
