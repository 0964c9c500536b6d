#include "WriteSide.h"

#include <algorithm>

#include <common/Json.h>
#include "Address.h"
#include "DraftReader.h"
#include "Session.h"
#include "Upload.h"

namespace service {
namespace {

constexpr goffset kMaxJson = 2 << 20;
constexpr guint kLongestPollS = 25;
constexpr guint kLongestHoldMs = 25000;
constexpr char kSharingService[] = "2";

common::JsonTree readBody(SoupServerMessage* message) {
  const Bytes body(soup_message_body_flatten(soup_server_message_get_request_body(message)));
  gsize size = 0;
  const auto* data = static_cast<const char*>(g_bytes_get_data(body.get(), &size));
  return common::parseJsonObject({data ? data : "", size});
}

std::string shareJson(const Share& share) {
  common::JsonWriter json;
  json.open()
      .text("token", share.token)
      .number("request_id", share.id)
      .text("state", share.state == ShareState::Preparing ? "preparing" : "open")
      .number("expires_ms", share.expiresMs);
  return json.close().str();
}

void boundJson(SoupServerMessage* message) {
  SoupMessageHeaders* headers = soup_server_message_get_request_headers(message);
  if (soup_message_headers_get_content_length(headers) > kMaxJson) {
    answerError(message, SOUP_STATUS_REQUEST_ENTITY_TOO_LARGE, "at most 2 MiB of JSON");
    return;
  }
  if (soup_message_headers_get_encoding(headers) == SOUP_ENCODING_CHUNKED) {
    answerError(message, SOUP_STATUS_LENGTH_REQUIRED, "JSON with a length");
  }
}

bool isUpload(SoupServerMessage* message, const WriteSide::Words& path) {
  return path.size() == 5 && path[1] == "shares" && path[3] == "files" &&
         g_str_equal(soup_server_message_get_method(message), "PUT");
}

}  // namespace

WriteSide::WriteSide(Catalog& catalog, BlobStore& blobs, PushHub& hub, ShareDesk& desk,
                     bool lenient)
    : _catalog(catalog), _blobs(blobs), _hub(hub), _desk(desk), _lenient(lenient) {
  _desk.setPublishedListener([this](std::int64_t id) { publishedCb(id); });
}

void WriteSide::prepare(SoupServerMessage* message, const Words& path) {
  if (isUpload(message, path)) {
    prepareUpload(message, path);
  } else {
    boundJson(message);
  }
}

void WriteSide::prepareUpload(SoupServerMessage* message, const Words& path) {
  const auto share = ownShare(message, path[2]);
  if (!share) return;
  const auto index = plainNumber(path[4]);
  const auto file = index ? _catalog.file(share->id, *index) : std::nullopt;
  if (!file) {
    answerError(message, SOUP_STATUS_NOT_FOUND, "no such file");
    return;
  }
  if (share->state != ShareState::Draft) {
    answerError(message, SOUP_STATUS_CONFLICT, "the share is complete");
    return;
  }
  SoupMessageHeaders* headers = soup_server_message_get_request_headers(message);
  const std::int64_t limit = file->size.value_or(kMaxFileSize);
  if (soup_message_headers_get_encoding(headers) == SOUP_ENCODING_CONTENT_LENGTH &&
      soup_message_headers_get_content_length(headers) > limit) {
    answerError(message, SOUP_STATUS_REQUEST_ENTITY_TOO_LARGE, "longer than announced");
    return;
  }
  // A lenient share may announce a wrong size.
  Upload::attach(message, _blobs.incoming(), share->lenient ? -1 : file->size.value_or(-1), limit);
}

bool WriteSide::answer(SoupServerMessage* message, const Words& path, GHashTable* query) {
  const std::string method = soup_server_message_get_method(message);
  const std::string what = path.size() > 1 ? path[1] : std::string();
  if (what == "shares") return answerShares(message, path);
  if (what == "push" && path.size() == 2 && method == "GET") return push(message, query);
  if (what == "subscribers" && path.size() == 2 && method == "POST") {
    signUp(message);
  } else if (what == "subscribers" && path.size() == 5 && path[3] == "services" &&
             path[4] == kSharingService && (method == "GET" || method == "PUT")) {
    sharingStatus(message, path[2]);
  } else {
    answerError(message, SOUP_STATUS_NOT_FOUND, "no such operation");
  }
  return true;
}

bool WriteSide::answerShares(SoupServerMessage* message, const Words& path) {
  const std::string method = soup_server_message_get_method(message);
  if (path.size() == 2 && method == "POST") {
    create(message);
    return true;
  }
  const bool transfer = isUpload(message, path);
  const bool action = path.size() == 4 && method == "POST";
  if (!transfer && !action) {
    answerError(message, SOUP_STATUS_NOT_FOUND, "no such operation");
    return true;
  }
  const auto share = ownShare(message, path[2]);
  if (!share) return true;
  if (transfer) {
    upload(message, *share, plainNumber(path[4]).value_or(-1));
  } else if (path[3] == "complete") {
    return complete(message, *share);
  } else if (path[3] == "recall") {
    recall(message, *share);
  } else {
    answerError(message, SOUP_STATUS_NOT_FOUND, "no such operation");
  }
  return true;
}

std::optional<Share> WriteSide::ownShare(SoupServerMessage* message, const std::string& id) {
  const auto caller = authenticate(message, _catalog);
  if (!caller) return std::nullopt;
  const auto number = plainNumber(id);
  auto share = number ? _catalog.share(*number) : std::nullopt;
  if (!share) {
    answerError(message, SOUP_STATUS_NOT_FOUND, "no such share");
  } else if (share->sender != *caller) {
    answerError(message, SOUP_STATUS_FORBIDDEN, "only its sender may do this");
    share.reset();
  }
  return share;
}

void WriteSide::create(SoupServerMessage* message) {
  const auto sender = authenticate(message, _catalog);
  if (!sender) return;
  if (!_catalog.sharingOn(*sender).value_or(false)) {
    answerError(message, SOUP_STATUS_FORBIDDEN, "sharing is switched off");
    return;
  }
  const common::JsonTree body = readBody(message);
  ShareDraft draft;
  draft.sender = *sender;
  const char* reason =
      body ? readDraft(json_node_get_object(body.get()), draft) : "a JSON object is expected";
  if (!reason && draft.lenient && !_lenient) reason = "lenient: not at this service";
  if (reason) {
    answerError(message, SOUP_STATUS_BAD_REQUEST, reason);
    return;
  }
  const auto share = _catalog.create(draft, nowMs());
  if (!share || !_blobs.makeStaging(share->id)) {
    answerError(message, SOUP_STATUS_INSUFFICIENT_STORAGE, "cannot be stored");
    return;
  }
  common::JsonWriter json;
  json.open()
      .text("token", share->token)
      .number("request_id", share->id)
      .text("upload", "/v1/shares/" + std::to_string(share->id) + "/files/{n}");
  answerJson(message, SOUP_STATUS_CREATED, json.close().str());
}

void WriteSide::upload(SoupServerMessage* message, const Share& share, std::int64_t index) {
  Upload* upload = Upload::of(message);
  const auto file = _catalog.file(share.id, index);
  if (!upload || !file || share.state != ShareState::Draft) {
    answerError(message, SOUP_STATUS_CONFLICT, "the share is complete");
    return;
  }
  switch (upload->finish(_blobs.staged(share.id, BlobKind::File, index))) {
    case Upload::Result::Complete:
      _desk.fileArrived(share.id, index, *file);
      soup_server_message_set_status(message, SOUP_STATUS_NO_CONTENT, nullptr);
      break;
    case Upload::Result::TooLong:
      answerError(message, SOUP_STATUS_REQUEST_ENTITY_TOO_LARGE, "longer than announced");
      break;
    case Upload::Result::TooShort:
      answerError(message, SOUP_STATUS_BAD_REQUEST, "shorter than announced");
      break;
    case Upload::Result::DiskError:
      answerError(message, SOUP_STATUS_INSUFFICIENT_STORAGE, "cannot be stored");
      break;
  }
}

bool WriteSide::complete(SoupServerMessage* message, const Share& share) {
  if (share.closed()) {
    answerError(message, SOUP_STATUS_GONE, "recalled or expired");
    return true;
  }
  if (const char* reason = _desk.complete(share)) {
    answerError(message, SOUP_STATUS_CONFLICT, reason);
    return true;
  }
  const auto now = _catalog.share(share.id);
  if (!now || now->state != ShareState::Preparing) {
    answerJson(message, SOUP_STATUS_OK, shareJson(now.value_or(share)));
    return true;
  }
  auto& [id, request] = _waiting.emplace_back(
      std::piecewise_construct, std::forward_as_tuple(share.id), std::forward_as_tuple(message));
  request.after(kLongestHoldMs, [this, &request = request, preparing = *now] {
    answerJson(request.message(), SOUP_STATUS_ACCEPTED, shareJson(preparing));
    request.release();
    _waiting.remove_if([](const auto& entry) { return !entry.second.message(); });
  });
  return false;
}

void WriteSide::publishedCb(std::int64_t published) {
  const auto share = _catalog.share(published);
  for (auto& [id, request] : _waiting) {
    if (id != published || !request.message() || !share) continue;
    answerJson(request.message(), SOUP_STATUS_OK, shareJson(*share));
    request.release();
  }
  _waiting.remove_if([](const auto& entry) { return !entry.second.message(); });
}

void WriteSide::recall(SoupServerMessage* message, const Share& share) {
  if (_desk.recall(share)) {
    answerJson(message, SOUP_STATUS_OK, "{}");
  } else {
    answerError(message, SOUP_STATUS_INSUFFICIENT_STORAGE, "cannot be stored");
  }
}

bool WriteSide::push(SoupServerMessage* message, GHashTable* query) {
  const auto caller = authenticate(message, _catalog);
  if (!caller) return true;
  const auto value = [query](const char* name) {
    const auto* text = query ? static_cast<const char*>(g_hash_table_lookup(query, name)) : nullptr;
    return std::string(text ? text : "");
  };
  const std::string wait = value("wait");
  const auto after = plainNumber(value("after"));
  const auto waitS = wait.empty() ? kLongestPollS : plainNumber(wait);
  if (value("msisdn") != *caller) {
    answerError(message, SOUP_STATUS_FORBIDDEN, "not the caller's number");
  } else if (!after || !waitS) {
    answerError(message, SOUP_STATUS_BAD_REQUEST, "after and wait are numbers");
  } else {
    return _hub.poll(message, *caller, *after,
                     static_cast<guint>(std::min<std::int64_t>(*waitS, kLongestPollS)));
  }
  return true;
}

void WriteSide::signUp(SoupServerMessage* message) {
  const common::JsonTree body = readBody(message);
  JsonObject* json = body ? json_node_get_object(body.get()) : nullptr;
  const auto msisdn = json ? common::textMember(json, "msisdn") : std::nullopt;
  const auto imsi = json ? common::textMember(json, "imsi") : std::nullopt;
  if (!msisdn || !isMsisdn(*msisdn)) {
    answerError(message, SOUP_STATUS_BAD_REQUEST, "msisdn: a number in international form");
    return;
  }
  if (imsi && imsi->size() > 15) {
    answerError(message, SOUP_STATUS_BAD_REQUEST, "imsi: up to 15 digits");
    return;
  }
  const std::string key = _catalog.signUp(*msisdn, imsi.value_or(""));
  if (key.empty()) {
    answerError(message, SOUP_STATUS_INSUFFICIENT_STORAGE, "cannot be stored");
    return;
  }
  answerJson(message, SOUP_STATUS_CREATED,
             common::JsonWriter().open().text("msisdn", *msisdn).text("key", key).close().str());
}

void WriteSide::sharingStatus(SoupServerMessage* message, const std::string& msisdn) {
  const auto caller = authenticate(message, _catalog);
  if (!caller) return;
  if (*caller != msisdn) {
    answerError(message, SOUP_STATUS_FORBIDDEN, "not the caller's number");
    return;
  }
  if (g_str_equal(soup_server_message_get_method(message), "PUT")) {
    const common::JsonTree body = readBody(message);
    const auto status =
        body ? common::textMember(json_node_get_object(body.get()), "status") : std::nullopt;
    if (!status || (*status != "on" && *status != "off")) {
      answerError(message, SOUP_STATUS_BAD_REQUEST, "status: on or off");
      return;
    }
    if (!_catalog.setSharing(msisdn, *status == "on")) {
      answerError(message, SOUP_STATUS_INSUFFICIENT_STORAGE, "cannot be stored");
      return;
    }
  }
  const bool on = _catalog.sharingOn(msisdn).value_or(false);
  answerJson(message, SOUP_STATUS_OK,
             common::JsonWriter().open().text("status", on ? "on" : "off").close().str());
}

}  // namespace service
