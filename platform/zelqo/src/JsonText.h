/// JSON of strangers.
#pragma once

#include <base/Owned.h>
#include <json-glib/json-glib.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace zelqo {

using JsonTree = base::Owned<JsonNode, json_node_unref>;

/// Null for anything but well-formed JSON of moderate depth with an object as its root.
JsonTree parseJsonObject(std::string_view text);

/// Members of another type than asked for count as absent.
std::optional<std::string> textMember(JsonObject* object, const char* name);
std::optional<std::int64_t> numberMember(JsonObject* object, const char* name);
bool flagMember(JsonObject* object, const char* name);
JsonArray* arrayMember(JsonObject* object, const char* name);
JsonObject* objectMember(JsonObject* object, const char* name);

std::string writeJson(JsonNode* root);

}  // namespace zelqo
