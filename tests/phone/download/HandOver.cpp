#include "HandOver.h"

#include <gtest/gtest.h>
#include <json-glib/json-glib.h>

#include <memory>

using phone::thePhone;
using phone::Words;

namespace {

struct Release {
  void operator()(void* object) const { g_object_unref(object); }
};
using Parser = std::unique_ptr<JsonParser, Release>;

JsonObject* parsed(const Parser& parser, const std::string& line) {
  const bool isObject = json_parser_load_from_data(parser.get(), line.c_str(), -1, nullptr) &&
                        JSON_NODE_HOLDS_OBJECT(json_parser_get_root(parser.get()));
  EXPECT_TRUE(isObject) << line;
  return isObject ? json_node_get_object(json_parser_get_root(parser.get())) : nullptr;
}

std::string textOf(JsonObject* object, const char* member) {
  return json_object_get_string_member_with_default(object, member, "");
}

Words textsOf(JsonNode* value) {
  if (!JSON_NODE_HOLDS_ARRAY(value)) return {json_node_get_string(value)};
  Words texts;
  JsonArray* array = json_node_get_array(value);
  for (guint i = 0; i < json_array_get_length(array); i++) {
    texts.push_back(json_array_get_string_element(array, i));
  }
  return texts;
}

}  // namespace

Words HandOver::operator[](const std::string& key) const {
  for (const auto& [name, texts] : extras) {
    if (name == key) return texts;
  }
  return {};
}

std::vector<HandOver> handOvers() {
  std::vector<HandOver> result;
  for (const std::string& line : thePhone().lines("launches")) {
    const Parser parser(json_parser_new());
    JsonObject* launch = parsed(parser, line);
    if (!launch) continue;
    HandOver handOver{textOf(launch, "app_id"), textOf(launch, "operation"), {}};
    JsonArray* extras = json_object_get_array_member(launch, "extras");
    for (guint i = 0; i < json_array_get_length(extras); i++) {
      JsonArray* extra = json_array_get_array_element(extras, i);
      handOver.extras.emplace_back(json_array_get_string_element(extra, 0),
                                   textsOf(json_array_get_element(extra, 1)));
    }
    result.push_back(std::move(handOver));
  }
  return result;
}

Words usageRecords() {
  Words records;
  for (const std::string& line : thePhone().lines("usage")) {
    const Parser parser(json_parser_new());
    JsonObject* record = parsed(parser, line);
    if (record) records.push_back(textOf(record, "feature") + " " + textOf(record, "extra"));
  }
  return records;
}
