#include <notification/status.h>

#include "StatusSignal.h"

namespace notification {

StatusMessages::StatusMessages(std::function<void(const std::string&)> onMessage)
    : _onMessage(std::move(onMessage)),
      _posted(base::BusKind::Session, {nullptr, kStatusBar, kPosted, kStatusBarPath}, postedCb,
              this) {}

void StatusMessages::postedCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                              GVariant* arguments, void* data) {
  if (!g_variant_is_of_type(arguments, G_VARIANT_TYPE("(s)"))) return;
  const char* text = nullptr;
  g_variant_get(arguments, "(&s)", &text);
  static_cast<StatusMessages*>(data)->_onMessage(text);
}

}  // namespace notification
