#include "Recorder.h"

#include <json-glib/json-glib.h>

#include <cstring>

using common::Owned;
using common::OwnedObject;
using common::OwnedText;
using common::OwnedVariant;

namespace {

void addText(JsonBuilder* builder, const char* name, const char* text) {
  json_builder_set_member_name(builder, name);
  json_builder_add_string_value(builder, text);
}

/// Texts as they are, everything else as GLib writes it.
void addArguments(JsonBuilder* builder, GVariant* body) {
  json_builder_set_member_name(builder, "arguments");
  json_builder_begin_array(builder);
  for (gsize i = 0; i < g_variant_n_children(body); i++) {
    const OwnedVariant argument(g_variant_get_child_value(body, i));
    if (g_variant_is_of_type(argument.get(), G_VARIANT_TYPE_STRING)) {
      json_builder_add_string_value(builder, g_variant_get_string(argument.get(), nullptr));
    } else {
      const OwnedText text(g_variant_print(argument.get(), FALSE));
      json_builder_add_string_value(builder, text.get());
    }
  }
  json_builder_end_array(builder);
}

}  // namespace

Recorder::Recorder(const char* file)
    : _file(fopen(file, "ae")),
      _signals(base::BusKind::System, {nullptr, nullptr, nullptr, nullptr}, _signalCb, this) {}

void Recorder::_signalCb(GDBusConnection*, const char* sender, const char* path,
                         const char* interface, const char* member, GVariant* body, gpointer data) {
  const auto self = static_cast<Recorder*>(data);
  if (!self->_file || strcmp(interface, "org.freedesktop.DBus") == 0) return;
  const OwnedObject<JsonBuilder> builder(json_builder_new());
  json_builder_begin_object(builder.get());
  addText(builder.get(), "interface", interface);
  addText(builder.get(), "member", member);
  addText(builder.get(), "path", path);
  addText(builder.get(), "sender", sender);
  addArguments(builder.get(), body);
  json_builder_end_object(builder.get());
  const Owned<JsonNode, json_node_unref> root(json_builder_get_root(builder.get()));
  const OwnedText line(json_to_string(root.get(), FALSE));
  fprintf(self->_file.get(), "%s\n", line.get());
  fflush(self->_file.get());
}
