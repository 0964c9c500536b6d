#include "LaunchRecord.h"

#include "AppControl.h"
#include "BundleVariant.h"

#include <appfw/AppId.h>
#include <base/PhonePaths.h>
#include <fcntl.h>
#include <json-glib/json-glib.h>
#include <unistd.h>

namespace appfw {
namespace {

using OwnedBuilder = common::OwnedObject<JsonBuilder>;

void addMember(JsonBuilder* builder, const char* name, const std::string& value) {
  json_builder_set_member_name(builder, name);
  if (value.empty()) {
    json_builder_add_null_value(builder);
  } else {
    json_builder_add_string_value(builder, utf8(value).c_str());
  }
}

void addExtra(JsonBuilder* builder, const keyval_t& extra) {
  json_builder_begin_array(builder);
  json_builder_add_string_value(builder, utf8(extra.key).c_str());
  if (extra.isArray()) {
    json_builder_begin_array(builder);
    for (const auto& text : extra.texts) json_builder_add_string_value(builder, utf8(text).c_str());
    json_builder_end_array(builder);
  } else {
    json_builder_add_string_value(builder, utf8(extra.text).c_str());
  }
  json_builder_end_array(builder);
}

std::string line(const bundle& request) {
  OwnedBuilder builder(json_builder_new());
  json_builder_begin_object(builder.get());
  addMember(builder.get(), "caller", applicationId());
  addMember(builder.get(), "app_id", textOf(request, kKeyAppId));
  addMember(builder.get(), "operation", textOf(request, kKeyOperation));
  addMember(builder.get(), "uri", textOf(request, kKeyUri));
  addMember(builder.get(), "mime", textOf(request, kKeyMime));
  addMember(builder.get(), "launch_mode", textOf(request, kKeyLaunchMode));
  json_builder_set_member_name(builder.get(), "extras");
  json_builder_begin_array(builder.get());
  for (const auto& entry : request.entries) {
    if (!isSystemKey(entry.key)) addExtra(builder.get(), entry);
  }
  json_builder_end_array(builder.get());
  json_builder_end_object(builder.get());

  common::Owned<JsonNode, json_node_unref> root(json_builder_get_root(builder.get()));
  common::OwnedText text(json_to_string(root.get(), FALSE));
  return std::string(text.get()) + '\n';
}

}  // namespace

void recordLaunch(const bundle& request) {
  const std::string folder = base::databaseFolder();
  g_mkdir_with_parents(folder.c_str(), 0700);
  const int fd =
      open((folder + "/launches.jsonl").c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0600);
  if (fd < 0) return;
  const std::string text = line(request);
  [[maybe_unused]] const ssize_t written = write(fd, text.data(), text.size());
  close(fd);
}

}  // namespace appfw
