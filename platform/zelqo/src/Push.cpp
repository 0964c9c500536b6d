#include "zelqo/Push.h"

#include <glib.h>

#include <algorithm>
#include <cctype>

#include <common/Json.h>

namespace zelqo {
namespace {

constexpr std::size_t kMaxText = 8192;
constexpr std::size_t kMaxNumber = 32;
constexpr guint kMaxFiles = 10000;

bool isToken(const std::string& text) {
  return text.size() >= 16 && text.size() <= 128 &&
         std::all_of(text.begin(), text.end(),
                     [](unsigned char c) { return isalnum(c) || c == '-' || c == '_'; });
}

std::optional<std::string> boundedText(JsonObject* object, const char* name) {
  auto text = common::textMember(object, name);
  if (text && text->size() > kMaxText) return std::nullopt;
  return text;
}

// A file of which nothing can be read still has its place, so that the others keep theirs.
ReceivedFile readFile(JsonNode* node) {
  ReceivedFile file;
  if (!JSON_NODE_HOLDS_OBJECT(node)) return file;
  JsonObject* object = json_node_get_object(node);
  file.name = boundedText(object, "name");
  file.size = common::numberMember(object, "size");
  if (file.size && *file.size < 0) file.size.reset();
  file.type = boundedText(object, "type");
  file.url = boundedText(object, "url");
  file.thumb = boundedText(object, "thumb");
  file.mid = boundedText(object, "mid");
  file.big = boundedText(object, "big");
  return file;
}

bool readShare(JsonObject* object, ReceivedShare& share) {
  const auto sender = common::textMember(object, "from");
  const auto expires = common::numberMember(object, "expires_ms");
  JsonArray* files = common::arrayMember(object, "files");
  if (!sender || sender->empty() || sender->size() > kMaxNumber || !expires || !files) {
    return false;
  }
  share.sender = *sender;
  share.single = common::flagMember(object, "single");
  share.createdMs = common::numberMember(object, "created_ms").value_or(0);
  share.expiresMs = *expires;
  const guint count = std::min(json_array_get_length(files), kMaxFiles);
  share.files.reserve(count);
  for (guint i = 0; i < count; i++) {
    share.files.push_back(readFile(json_array_get_element(files, i)));
  }
  return true;
}

std::optional<PushEvent> readEvent(JsonNode* node) {
  if (!JSON_NODE_HOLDS_OBJECT(node)) return std::nullopt;
  JsonObject* object = json_node_get_object(node);
  const auto kind = common::textMember(object, "kind");
  const auto token = common::textMember(object, "token");
  if (!kind || !token || !isToken(*token)) return std::nullopt;
  PushEvent event;
  event.share.token = *token;
  if (*kind == "recalled") {
    event.kind = PushEvent::Kind::Recalled;
    return event;
  }
  JsonObject* share = common::objectMember(object, "share");
  if (*kind != "received" || !share || !readShare(share, event.share)) return std::nullopt;
  event.share.base = boundedText(object, "base").value_or("");
  return event;
}

}  // namespace

std::optional<Push> readPush(std::string_view json) {
  const common::JsonTree root = common::parseJsonObject(json);
  JsonObject* object = root ? json_node_get_object(root.get()) : nullptr;
  JsonArray* events = object ? common::arrayMember(object, "events") : nullptr;
  const auto cursor = object ? common::numberMember(object, "cursor") : std::nullopt;
  if (!events || !cursor || *cursor < 0) return std::nullopt;
  Push push;
  push.cursor = *cursor;
  for (guint i = 0; i < json_array_get_length(events); i++) {
    if (auto event = readEvent(json_array_get_element(events, i))) {
      push.events.push_back(std::move(*event));
    } else {
      g_warning("zelqo: a push of the service makes no sense and is left out");
    }
  }
  return push;
}

}  // namespace zelqo
