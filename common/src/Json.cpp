#include <common/Json.h>

namespace common {
namespace {

constexpr int kMaxDepth = 32;

/// The number of an escaped character; -1 when the text begins with something else.
int escapedCharacter(std::string_view text) {
  if (text.size() < 6 || text[0] != '\\' || text[1] != 'u') return -1;
  int number = 0;
  for (std::size_t i = 2; i < 6; i++) {
    const int digit = g_ascii_xdigit_value(text[i]);
    if (digit < 0) return -1;
    number = number * 16 + digit;
  }
  return number;
}

/// The length of an escape; 0 for a broken one or half a pair, over which the parser would forget
/// to free the whole text.
std::size_t lengthOfEscape(std::string_view text) {
  if (text.substr(0, 2) != "\\u") return 2;
  const int number = escapedCharacter(text);
  if (number < 0) return 0;
  if (number >> 11 != 0xd800 >> 11) return 6;
  const bool pair = number < 0xdc00 && escapedCharacter(text.substr(6)) >> 10 == 0xdc00 >> 10;
  return pair ? 12 : 0;
}

/// The length of the text behind its first quote, with its second; 0 for a broken one.
std::size_t lengthOfText(std::string_view text) {
  std::size_t at = 0;
  while (at < text.size() && text[at] != '"') {
    const std::size_t length = text[at] == '\\' ? lengthOfEscape(text.substr(at)) : 1;
    if (length == 0) return 0;
    at += length;
  }
  return at + 1;
}

/// Can the parser be trusted with it? It recurses without a limit of its own: a megabyte of
/// brackets would end the process. It also takes comments and texts in single quotes, in which a
/// quote could hide brackets from this look; no JSON has either.
bool isHarmless(std::string_view text) {
  int depth = 0;
  for (std::size_t at = 0; at < text.size(); at++) {
    const char c = text[at];
    if (c == '/' || c == '\'') return false;
    if (c == '[' || c == '{') depth++;
    if (c == ']' || c == '}') depth--;
    if (depth < 0 || depth > kMaxDepth) return false;
    if (c != '"') continue;
    const std::size_t length = lengthOfText(text.substr(at + 1));
    if (length == 0) return false;
    at += length;
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
      !isHarmless(text)) {
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
