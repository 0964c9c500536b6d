/// JSON of strangers in, JSON of ours out.
#pragma once

#include <common/Owned.h>
#include <json-glib/json-glib.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace common {

using JsonTree = Owned<JsonNode, json_node_unref>;

/// Null for anything but well-formed JSON with an object as its root and of moderate depth.
JsonTree parseJsonObject(std::string_view text);

/// Members of another type than asked for count as absent.
std::optional<std::string> textMember(JsonObject* object, const char* name);
std::optional<std::int64_t> numberMember(JsonObject* object, const char* name);
bool flagMember(JsonObject* object, const char* name);
JsonArray* arrayMember(JsonObject* object, const char* name);
JsonObject* objectMember(JsonObject* object, const char* name);

std::string writeJson(JsonNode* root);

class JsonWriter {
 public:
  JsonWriter();
  JsonWriter& open();
  JsonWriter& close();
  JsonWriter& openArray(const char* name);
  JsonWriter& closeArray();
  JsonWriter& text(const char* name, const std::string& value);
  JsonWriter& number(const char* name, std::int64_t value);
  JsonWriter& flag(const char* name, bool value);
  JsonWriter& tree(const char* name, JsonNode* value);
  /// A text in an array.
  JsonWriter& item(const std::string& value);
  std::string str() const;

 private:
  JsonBuilder* get() const { return _builder.get(); }
  OwnedObject<JsonBuilder> _builder;
};

}  // namespace common
