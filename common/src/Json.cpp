#include <common/Json.h>

namespace common {
namespace {

constexpr int kMaxDepth = 32;

// The parser recurses without a limit of its own: a megabyte of brackets would end the process. It
// also takes comments and texts in single quotes, in which a quote could hide brackets from this
// look; no JSON has either.
bool isShallow(std::string_view text) {
  int depth = 0;
  bool quoted = false;
  for (std::size_t i = 0; i < text.size(); i++) {
    const char c = text[i];
    if (quoted) {
      if (c == '\\') i++;
      if (c == '"') quoted = false;
    } else if (c == '"') {
      quoted = true;
    } else if (c == '/' || c == '\'') {
      return false;
    } else if (c == '[' || c == '{') {
      if (++depth > kMaxDepth) return false;
    } else if (c == ']' || c == '}') {
      if (--depth < 0) return false;
    }
  }
  return true;
}

JsonNode* valueMember(JsonObject* object, const char* name) {
  JsonNode* node = json_object_get_member(object, name);
  return node && JSON_NODE_HOLDS_VALUE(node) ? node : nullptr;
}

}  // namespace

JsonTree parseJsonObject(std::string_view text) {
  if (!g_utf8_validate(text.data(), static_cast<gssize>(text.size()), nullptr) ||
      !isShallow(text)) {
    return nullptr;
  }
  // Of several documents in a row the parser gives the last and never frees the others. Between
  // brackets there can be only one.
  const std::string bracketed = "[" + std::string(text) + "]";
  const OwnedObject<JsonParser> parser(json_parser_new_immutable());
  if (!json_parser_load_from_data(parser.get(), bracketed.data(),
                                  static_cast<gssize>(bracketed.size()), nullptr)) {
    return nullptr;
  }
  JsonArray* documents = json_node_get_array(json_parser_get_root(parser.get()));
  JsonNode* root =
      json_array_get_length(documents) == 1 ? json_array_get_element(documents, 0) : nullptr;
  return JsonTree(root && JSON_NODE_HOLDS_OBJECT(root) ? json_node_copy(root) : nullptr);
}

std::optional<std::string> textMember(JsonObject* object, const char* name) {
  JsonNode* node = valueMember(object, name);
  if (!node || json_node_get_value_type(node) != G_TYPE_STRING) return std::nullopt;
  return json_node_get_string(node);
}

std::optional<std::int64_t> numberMember(JsonObject* object, const char* name) {
  JsonNode* node = valueMember(object, name);
  if (!node || json_node_get_value_type(node) != G_TYPE_INT64) return std::nullopt;
  return json_node_get_int(node);
}

bool flagMember(JsonObject* object, const char* name) {
  JsonNode* node = valueMember(object, name);
  return node && json_node_get_value_type(node) == G_TYPE_BOOLEAN && json_node_get_boolean(node);
}

JsonArray* arrayMember(JsonObject* object, const char* name) {
  JsonNode* node = json_object_get_member(object, name);
  return node && JSON_NODE_HOLDS_ARRAY(node) ? json_node_get_array(node) : nullptr;
}

JsonObject* objectMember(JsonObject* object, const char* name) {
  JsonNode* node = json_object_get_member(object, name);
  return node && JSON_NODE_HOLDS_OBJECT(node) ? json_node_get_object(node) : nullptr;
}

std::string writeJson(JsonNode* root) {
  const OwnedText text(json_to_string(root, FALSE));
  return text.get();
}

JsonWriter::JsonWriter() : _builder(json_builder_new_immutable()) {}

JsonWriter& JsonWriter::open() {
  json_builder_begin_object(get());
  return *this;
}

JsonWriter& JsonWriter::close() {
  json_builder_end_object(get());
  return *this;
}

JsonWriter& JsonWriter::openArray(const char* name) {
  json_builder_set_member_name(get(), name);
  json_builder_begin_array(get());
  return *this;
}

JsonWriter& JsonWriter::closeArray() {
  json_builder_end_array(get());
  return *this;
}

JsonWriter& JsonWriter::text(const char* name, const std::string& value) {
  json_builder_set_member_name(get(), name);
  return item(value);
}

JsonWriter& JsonWriter::number(const char* name, std::int64_t value) {
  json_builder_set_member_name(get(), name);
  json_builder_add_int_value(get(), value);
  return *this;
}

JsonWriter& JsonWriter::flag(const char* name, bool value) {
  json_builder_set_member_name(get(), name);
  json_builder_add_boolean_value(get(), value);
  return *this;
}

JsonWriter& JsonWriter::tree(const char* name, JsonNode* value) {
  json_builder_set_member_name(get(), name);
  json_builder_add_value(get(), json_node_ref(value));
  return *this;
}

JsonWriter& JsonWriter::item(const std::string& value) {
  json_builder_add_string_value(get(), value.c_str());
  return *this;
}

std::string JsonWriter::str() const {
  const JsonTree root(json_builder_get_root(get()));
  return writeJson(root.get());
}

}  // namespace common
