#include "Notify.h"

#include <dlog.h>

namespace notification {

void notify(GDBusConnection* bus, const Message& message, GAsyncReadyCallback callback,
            void* data) {
  common::OwnedText valid(g_utf8_make_valid(message.text.c_str(), -1));
  common::OwnedText body(g_markup_escape_text(valid.get(), -1));
  GVariantBuilder actions, hints;
  g_variant_builder_init(&actions, G_VARIANT_TYPE_STRING_ARRAY);
  g_variant_builder_init(&hints, G_VARIANT_TYPE_VARDICT);
  if (message.openable) {
    g_variant_builder_add(&actions, "s", "default");
    g_variant_builder_add(&actions, "s", "");
  }
  if (message.stackTag) {
    g_variant_builder_add(&hints, "{sv}", "x-dunst-stack-tag",
                          g_variant_new_string(message.stackTag));
  }
  g_dbus_connection_call(bus, kService, kPath, kService, "Notify",
                         g_variant_new("(susssasa{sv}i)", "phone", message.replaces, "", "",
                                       body.get(), &actions, &hints, message.timeoutMs),
                         G_VARIANT_TYPE("(u)"), G_DBUS_CALL_FLAGS_NONE, -1, nullptr, callback,
                         data);
}

unsigned finishNotify(GObject* bus, GAsyncResult* result) {
  common::OwnedError error;
  common::OwnedVariant answer(
      g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, common::Out(error)));
  guint32 number = 0;
  if (answer) {
    g_variant_get(answer.get(), "(u)", &number);
  } else {
    dlog_print(DLOG_ERROR, "NOTIFICATION", "no message shown: %s", error->message);
  }
  return number;
}

}  // namespace notification
