#include "FolderView.h"

#include <base/Bus.h>
#include <companion/Launch.h>
#include <companion/Text.h>

namespace downloads {
namespace {

constexpr const char* kService = "org.freedesktop.FileManager1";
constexpr int kTimeoutMs = 10000;

void shownCb(GObject* bus, GAsyncResult* result, gpointer) {
  common::OwnedError error;
  const common::OwnedVariant answer(
      g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, common::Out(error)));
  if (answer) return;
  g_warning("downloads: no file manager: %s", error->message);
  companion::showMessage(companion::text("There is no file manager on this phone"));
}

}  // namespace

void showInFolder(const std::string& path) {
  const common::OwnedBus bus = base::sessionBus();
  const common::OwnedText uri(g_filename_to_uri(path.c_str(), nullptr, nullptr));
  if (!bus || !uri) return;
  const char* uris[] = {uri.get(), nullptr};
  g_dbus_connection_call(bus.get(), kService, "/org/freedesktop/FileManager1", kService,
                         "ShowItems", g_variant_new("(^ass)", uris, ""), nullptr,
                         G_DBUS_CALL_FLAGS_NONE, kTimeoutMs, nullptr, shownCb, nullptr);
}

}  // namespace downloads
