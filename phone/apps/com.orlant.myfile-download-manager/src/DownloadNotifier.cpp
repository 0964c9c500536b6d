#include "DownloadNotifier.h"

#include <companion/Text.h>

#include <memory>

namespace downloads {
namespace {

constexpr const char* kService = "org.freedesktop.Notifications";
constexpr const char* kPath = "/org/freedesktop/Notifications";
constexpr int kShownMs = 5000;
constexpr std::size_t kMaxRemembered = 20;

}  // namespace

struct DownloadNotifier::Posted {
  DownloadNotifier* notifier;
  std::function<void()> onTap;
};

DownloadNotifier::DownloadNotifier()
    : _bus(base::sessionBus()),
      _invoked(base::BusKind::Session, {nullptr, kService, "ActionInvoked", kPath}, _invokedCb,
               this) {}

void DownloadNotifier::post(const std::string& message, std::function<void()> onTap) {
  if (!_bus) return;
  const common::OwnedText body(g_markup_escape_text(message.c_str(), -1));
  GVariantBuilder actions;
  g_variant_builder_init(&actions, G_VARIANT_TYPE_STRING_ARRAY);
  g_variant_builder_add(&actions, "s", "default");
  g_variant_builder_add(&actions, "s", companion::text("Open"));
  g_dbus_connection_call(_bus.get(), kService, kPath, kService, "Notify",
                         g_variant_new("(susssasa{sv}i)", companion::text("Downloads"), 0u, "", "",
                                       body.get(), &actions, nullptr, kShownMs),
                         G_VARIANT_TYPE("(u)"), G_DBUS_CALL_FLAGS_NONE, -1, nullptr, _postedCb,
                         new Posted{this, std::move(onTap)});
}

void DownloadNotifier::_postedCb(GObject* bus, GAsyncResult* result, gpointer data) {
  const std::unique_ptr<Posted> posted(static_cast<Posted*>(data));
  common::OwnedError error;
  const common::OwnedVariant answer(
      g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, common::Out(error)));
  if (!answer) {
    g_warning("downloads: no notification: %s", error->message);
    return;
  }
  unsigned int id = 0;
  g_variant_get(answer.get(), "(u)", &id);
  auto& handlers = posted->notifier->_handlers;
  handlers[id] = std::move(posted->onTap);
  if (handlers.size() > kMaxRemembered) handlers.erase(handlers.begin());
}

void DownloadNotifier::_invokedCb(GDBusConnection*, const char*, const char*, const char*,
                                  const char*, GVariant* arguments, void* data) {
  if (!g_variant_is_of_type(arguments, G_VARIANT_TYPE("(us)"))) return;
  unsigned int id = 0;
  g_variant_get(arguments, "(u&s)", &id, nullptr);
  auto& handlers = static_cast<DownloadNotifier*>(data)->_handlers;
  const auto found = handlers.find(id);
  if (found == handlers.end()) return;
  const auto onTap = std::move(found->second);
  handlers.erase(found);
  onTap();
}

}  // namespace downloads
