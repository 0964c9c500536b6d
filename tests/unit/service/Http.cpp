#include "Http.h"

namespace {

struct Unref {
  void operator()(void* object) const { g_object_unref(object); }
};
template <typename T>
using Ref = std::unique_ptr<T, Unref>;

SoupSession* session() {
  static const Ref<SoupSession> session(soup_session_new_with_options("timeout", 60, nullptr));
  return session.get();
}

Ref<SoupMessage> makeMessage(const char* method, const std::string& url,
                             const HttpHeaders& headers) {
  Ref<SoupMessage> message(soup_message_new(method, url.c_str()));
  for (const auto& [name, value] : headers) {
    soup_message_headers_replace(soup_message_get_request_headers(message.get()), name.c_str(),
                                 value.c_str());
  }
  return message;
}

HttpAnswer exchange(SoupMessage* message) {
  HttpAnswer answer;
  GBytes* bytes = soup_session_send_and_read(session(), message, nullptr, nullptr);
  if (!bytes) return answer;
  gsize size = 0;
  const auto* data = static_cast<const char*>(g_bytes_get_data(bytes, &size));
  if (data) answer.body.assign(data, size);
  g_bytes_unref(bytes);
  answer.status = soup_message_get_status(message);
  soup_message_headers_foreach(
      soup_message_get_response_headers(message),
      [](const char* name, const char* value, gpointer headers) {
        (*static_cast<std::map<std::string, std::string>*>(headers))[name] = value;
      },
      &answer.headers);
  return answer;
}

JsonNode* member(const Json& json, const std::string& name) {
  if (!json || !JSON_NODE_HOLDS_OBJECT(json.get())) return nullptr;
  return json_object_get_member(json_node_get_object(json.get()), name.c_str());
}

}  // namespace

std::string HttpAnswer::text(const std::string& name) const {
  const Json json = parseJson(body);
  JsonNode* node = member(json, name);
  const char* text = node ? json_node_get_string(node) : nullptr;
  return text ? text : "";
}

long long HttpAnswer::number(const std::string& name) const {
  const Json json = parseJson(body);
  JsonNode* node = member(json, name);
  return node ? json_node_get_int(node) : -1;
}

HttpAnswer http(const char* method, const std::string& url, const std::string& body,
                const HttpHeaders& headers) {
  const Ref<SoupMessage> message = makeMessage(method, url, headers);
  if (!body.empty()) {
    GBytes* bytes = g_bytes_new(body.data(), body.size());
    soup_message_set_request_body_from_bytes(message.get(), "application/json", bytes);
    g_bytes_unref(bytes);
  }
  return exchange(message.get());
}

HttpAnswer httpGet(const std::string& url, const HttpHeaders& headers) {
  return http("GET", url, {}, headers);
}

HttpAnswer httpSend(const std::string& url, const std::string& file, const HttpHeaders& headers) {
  const Ref<SoupMessage> message = makeMessage("PUT", url, headers);
  const Ref<GFile> source(g_file_new_for_path(file.c_str()));
  const Ref<GFileInputStream> stream(g_file_read(source.get(), nullptr, nullptr));
  const Ref<GFileInfo> info(g_file_query_info(source.get(), G_FILE_ATTRIBUTE_STANDARD_SIZE,
                                              G_FILE_QUERY_INFO_NONE, nullptr, nullptr));
  soup_message_set_request_body(message.get(), nullptr, G_INPUT_STREAM(stream.get()),
                                g_file_info_get_size(info.get()));
  return exchange(message.get());
}

long long httpCount(const std::string& url) {
  const Ref<SoupMessage> message = makeMessage("GET", url, {});
  const Ref<GInputStream> stream(soup_session_send(session(), message.get(), nullptr, nullptr));
  long long count = 0;
  std::vector<char> piece(1 << 16);
  while (stream) {
    const gssize size =
        g_input_stream_read(stream.get(), piece.data(), piece.size(), nullptr, nullptr);
    if (size <= 0) break;
    count += size;
  }
  return count;
}

Json parseJson(const std::string& text) {
  JsonNode* node = text.empty() ? nullptr : json_from_string(text.c_str(), nullptr);
  return Json(node, [](JsonNode* root) {
    if (root) json_node_unref(root);
  });
}
