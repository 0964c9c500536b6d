#include "DownloadSignals.h"

#include <base/Bus.h>

namespace downloads {

void DownloadSignals::_emit(const char* member, const std::string& url) {
  // A bus closes the connection of who sends it anything but UTF-8.
  if (!g_utf8_validate(url.c_str(), -1, nullptr)) return;
  const common::OwnedBus bus = base::systemBus();
  if (!bus) return;
  common::OwnedError error;
  g_dbus_connection_emit_signal(bus.get(), nullptr, "/com/orlant/remoteshare",
                                "org.tizen.call.remote.share", member,
                                g_variant_new("(s)", url.c_str()), common::Out(error));
  if (error) g_warning("downloads: %s: %s", member, error->message);
}

}  // namespace downloads
