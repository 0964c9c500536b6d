#include "ServiceClient.h"

#include <gio/gio.h>

#include <utility>

namespace zelqo {
namespace {

constexpr int kConnections = 6;
constexpr std::size_t kMaxReason = 512;

void attachJson(SoupMessage* message, const std::string& json) {
  const common::Owned<GBytes, g_bytes_unref> bytes(g_bytes_new(json.data(), json.size()));
  soup_message_set_request_body_from_bytes(message, "application/json", bytes.get());
}

bool attachFile(SoupMessage* message, const std::string& path) {
  const common::Owned<GFile, g_object_unref> file(g_file_new_for_path(path.c_str()));
  common::OwnedError error;
  const common::Owned<GFileInputStream, g_object_unref> stream(
      g_file_read(file.get(), nullptr, common::Out(error)));
  const common::Owned<GFileInfo, g_object_unref> info(
      stream ? g_file_input_stream_query_info(stream.get(), G_FILE_ATTRIBUTE_STANDARD_SIZE, nullptr,
                                              nullptr)
             : nullptr);
  if (!info) {
    g_warning("zelqo: cannot read a file to send: %s", error ? error->message : "no size");
    return false;
  }
  soup_message_set_request_body(message, "application/octet-stream", G_INPUT_STREAM(stream.get()),
                                g_file_info_get_size(info.get()));
  return true;
}

std::string errorText(const std::string& body, const std::string& fallback) {
  const common::JsonTree json = common::parseJsonObject(body);
  const auto text =
      json ? common::textMember(json_node_get_object(json.get()), "error") : std::nullopt;
  return text && text->size() <= kMaxReason ? *text : fallback;
}

}  // namespace

struct ServiceClient::Call {
  std::string body;
  ReplyCb reply;
  std::function<void(goffset)> sent;
  std::unique_ptr<HttpFetch> fetch;

  static void wroteCb(SoupMessage*, guint size, gpointer call) {
    static_cast<Call*>(call)->sent(size);
  }
};

ServiceClient::ServiceClient(std::string url, guint deadlineMs)
    : _url(std::move(url)),
      _deadlineMs(deadlineMs),
      // Waiting for news is no inactivity; the deadline bounds it.
      _session(makeSession(kConnections, 0)) {}

ServiceClient::~ServiceClient() = default;

MessageOwner ServiceClient::message(const Request& request) const {
  MessageOwner message = makeMessage(request.method, _url + request.path);
  if (!message) return nullptr;
  // Nobody else gets the key, whatever the service says.
  soup_message_add_flags(message.get(), SOUP_MESSAGE_NO_REDIRECT);
  if (!request.key.empty()) {
    soup_message_headers_replace(soup_message_get_request_headers(message.get()), "Authorization",
                                 ("Bearer " + request.key).c_str());
  }
  if (!request.json.empty()) attachJson(message.get(), request.json);
  if (!request.file.empty() && !attachFile(message.get(), request.file)) return nullptr;
  return message;
}

bool ServiceClient::send(const Request& request, ReplyCb reply) {
  MessageOwner prepared = message(request);
  if (!prepared) return false;
  Call& call = _calls.emplace_back();
  call.reply = std::move(reply);
  call.sent = request.sent;
  if (call.sent) {
    g_signal_connect(prepared.get(), "wrote-body-data", G_CALLBACK(Call::wroteCb), &call);
  }
  call.fetch = std::make_unique<HttpFetch>(
      _session.get(), std::move(prepared), HttpFetch::Limits{8 << 20, _deadlineMs},
      [&call](guint, const char* data, gsize size) {
        call.body.append(data, size);
        return true;
      },
      [this, &call](const HttpFetch::Outcome& outcome) { finished(call, outcome); });
  return true;
}

void ServiceClient::finished(Call& call, const HttpFetch::Outcome& outcome) {
  Reply reply;
  reply.error = outcome.error;
  reply.status = outcome.status;
  reply.reason = outcome.error ? errorText(call.body, outcome.reason) : std::string();
  reply.body = std::move(call.body);
  if (outcome.status) {
    const char* cursor = soup_message_headers_get_one(
        soup_message_get_response_headers(call.fetch->message()), "Push-Cursor");
    if (cursor) reply.cursor = cursor;
  }
  const ReplyCb done = std::move(call.reply);
  _calls.remove_if([&call](const Call& other) { return &other == &call; });
  done(std::move(reply));
}

}  // namespace zelqo
