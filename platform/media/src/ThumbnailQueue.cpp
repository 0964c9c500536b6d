#include "ThumbnailQueue.h"

#include <base/Bus.h>

#include <unordered_set>
#include <vector>

namespace media {
namespace {

constexpr const char* kService = "org.freedesktop.thumbnails.Thumbnailer1";
constexpr const char* kPath = "/org/freedesktop/thumbnails/Thumbnailer1";
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
    const common::OwnedText uri(g_filename_to_uri(path.c_str(), nullptr, nullptr));
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
    const common::OwnedVariant arguments(g_variant_ref_sink(
        g_variant_new("(asasssu)", &uris, &types, kThumbnailSize, "foreground", 0u)));
    const common::OwnedBus bus = base::sessionBus();
    if (!bus) return;
    g_dbus_connection_call(bus.get(), kService, kPath, kService, "Queue", arguments.get(), nullptr,
                           G_DBUS_CALL_FLAGS_NONE, kTimeoutMs, nullptr, nullptr, nullptr);
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
