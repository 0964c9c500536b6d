#include "zelqo/Uploader.h"

#include <sys/stat.h>
#include <unistd.h>

#include <utility>

#include "FileType.h"
#include "ServiceClient.h"
#include "zelqo/Account.h"
#include "zelqo/PhoneSettings.h"

namespace zelqo {
namespace {

// One file over a slow connection; also longer than the service holds a request.
constexpr guint kDeadlineMs = 15 * 60 * 1000;
constexpr guint kAccepted = 202;
constexpr guint kUnauthorized = 401;
constexpr std::int64_t kMaxFileSize = 0xffffffff;

std::string nameOf(const std::string& path) {
  const common::OwnedText name(g_path_get_basename(path.c_str()));
  const common::OwnedText valid(g_utf8_make_valid(name.get(), -1));
  return valid.get();
}

}  // namespace

Uploader::Uploader(Store& store, const std::string& serviceUrl)
    : _store(store),
      _serviceUrl(serviceUrl.empty() ? zelqo::serviceUrl() : serviceUrl),
      _client(std::make_unique<ServiceClient>(_serviceUrl, kDeadlineMs)) {}

Uploader::~Uploader() {
  if (_start) g_source_remove(_start);
}

bool Uploader::start(Request request, ProgressCb progress, DoneCb done) {
  if (_busy) return false;
  _busy = true;
  _request = std::move(request);
  _progress = std::move(progress);
  _done = std::move(done);
  _result = {};
  _files.clear();
  _next = 0;
  _sent = _total = 0;
  _renewed = false;
  _account = std::make_unique<Account>(_store, _request.from, _serviceUrl);
  _start = g_idle_add_full(G_PRIORITY_DEFAULT, beginCb, this, nullptr);
  return true;
}

gboolean Uploader::beginCb(void* self) {
  auto* uploader = static_cast<Uploader*>(self);
  uploader->_start = 0;
  uploader->begin();
  return G_SOURCE_REMOVE;
}

void Uploader::begin() {
  if (!checkRequest() || !readFiles()) return;
  if (_account->signedUp()) {
    announce();
  } else {
    signUp();
  }
}

bool Uploader::checkRequest() {
  if (_request.rawFiles.empty()) return true;
  const common::JsonTree raw(json_from_string(_request.rawFiles.c_str(), nullptr));
  if (raw && JSON_NODE_HOLDS_ARRAY(raw.get())) return true;
  fail(ZELQO_ERROR_INVALID_PARAMETER, "the raw manifest is no JSON array");
  return false;
}

bool Uploader::readFiles() {
  for (const std::string& path : _request.paths) {
    struct stat status;
    const bool usable = stat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode) &&
                        access(path.c_str(), R_OK) == 0 && status.st_size <= kMaxFileSize;
    if (!usable) {
      fail(ZELQO_ERROR_INVALID_PARAMETER, "not a readable file: " + path);
      return false;
    }
    _files.push_back({path, nameOf(path), fileType(path), status.st_size});
    _total += status.st_size;
  }
  return true;
}

void Uploader::signUp() {
  _renewed = true;
  _account->signUp("", [this](int error) {
    if (error) {
      fail(error, "cannot sign up " + _request.from);
    } else {
      announce();
    }
  });
}

std::string Uploader::announcement() const {
  common::JsonWriter json;
  json.open();
  json.text("from", _request.from);
  json.number("expires_in_s", _request.lifetimeS);
  json.flag("single", _request.single);
  json.openArray("to");
  for (const std::string& number : _request.to) json.item(number);
  json.closeArray();
  json.flag("lenient", !_request.rawFiles.empty());
  if (!_request.rawFiles.empty()) {
    const common::JsonTree raw(json_from_string(_request.rawFiles.c_str(), nullptr));
    json.tree("files", raw.get());
  } else {
    json.openArray("files");
    for (const File& file : _files) {
      json.open().text("name", file.name).number("size", file.size).text("type", file.type).close();
    }
    json.closeArray();
  }
  return json.close().str();
}

void Uploader::announce() {
  ServiceClient::Request request;
  request.method = "POST";
  request.path = "/v1/shares";
  request.key = _store.accessKey(_request.from);
  request.json = announcement();
  const bool sent = _client->send(request, [this](const ServiceClient::Reply& reply) {
    if (reply.status == kUnauthorized && !_renewed) {
      signUp();
    } else if (reply.error) {
      fail(reply.error, reply.reason);
    } else {
      announced(reply.body);
    }
  });
  if (!sent) fail(ZELQO_ERROR_NETWORK, "no sharing service");
}

void Uploader::announced(const std::string& body) {
  const common::JsonTree json = common::parseJsonObject(body);
  JsonObject* object = json ? json_node_get_object(json.get()) : nullptr;
  const auto token = object ? common::textMember(object, "token") : std::nullopt;
  const auto id = object ? common::numberMember(object, "request_id") : std::nullopt;
  if (!token || !id) {
    fail(ZELQO_ERROR_REFUSED, "the service's answer makes no sense");
    return;
  }
  _result.token = *token;
  _result.requestId = *id;
  _createdMs = g_get_real_time() / 1000;
  sendNext();
}

void Uploader::sendNext() {
  if (_next == _files.size()) {
    complete();
    return;
  }
  ServiceClient::Request request;
  request.method = "PUT";
  request.path =
      "/v1/shares/" + std::to_string(_result.requestId) + "/files/" + std::to_string(_next);
  request.key = _store.accessKey(_request.from);
  request.file = _files[_next].path;
  request.sent = [this](goffset bytes) {
    _sent += bytes;
    if (_progress) _progress(_sent, _total);
  };
  const bool sent = _client->send(request, [this](const ServiceClient::Reply& reply) {
    if (reply.error) {
      fail(reply.error, _files[_next].name + ": " + reply.reason);
      return;
    }
    _next++;
    sendNext();
  });
  if (!sent) fail(ZELQO_ERROR_STORE, "cannot read " + _files[_next].path);
}

void Uploader::complete() {
  ServiceClient::Request request;
  request.method = "POST";
  request.path = "/v1/shares/" + std::to_string(_result.requestId) + "/complete";
  request.key = _store.accessKey(_request.from);
  const bool sent = _client->send(request, [this](const ServiceClient::Reply& reply) {
    if (reply.error) {
      fail(reply.error, reply.reason);
    } else if (reply.status == kAccepted) {
      complete();  // pictures are still being made
    } else {
      const common::JsonTree json = reply.json();
      JsonObject* object = json ? json_node_get_object(json.get()) : nullptr;
      if (object) _result.expiresMs = common::numberMember(object, "expires_ms").value_or(0);
      keep();
    }
  });
  if (!sent) fail(ZELQO_ERROR_NETWORK, "no sharing service");
}

void Uploader::keep() {
  if (_request.from == ownNumber()) {
    SentShare share;
    share.requestId = _result.requestId;
    share.token = _result.token;
    share.sender = _request.from;
    share.single = _request.single;
    share.createdMs = _createdMs;
    share.expiresMs = _result.expiresMs;
    share.recipients = _request.to;
    share.paths = _request.paths;
    if (!_store.addSent(share)) {
      fail(ZELQO_ERROR_STORE, "the share was sent, but cannot be recorded");
      return;
    }
  }
  finish();
}

void Uploader::fail(int error, const std::string& reason) {
  _result.error = error;
  _result.reason = reason;
  finish();
}

// Last in whatever calls it: the callback may start the next share or destroy this.
void Uploader::finish() {
  _busy = false;
  const DoneCb done = std::move(_done);
  const Result result = _result;
  done(result);
}

}  // namespace zelqo
