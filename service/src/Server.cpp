#include "Server.h"

#include <memory>
#include <utility>

#include <common/Json.h>
#include "Address.h"

namespace service {
namespace {

bool isStats(const std::vector<std::string>& path) {
  return path.size() == 2 && path[0] == "v1" && path[1] == "stats";
}

}  // namespace

Server::Server(Options options)
    : _options(std::move(options)),
      _blobs(_options.data),
      _hub(_catalog, _options.publicUrl),
      _desk(_catalog, _blobs, _hub, _options.thumbnailProgram),
      _readSide(_catalog, _blobs, _stats),
      _writeSide(_catalog, _blobs, _hub, _desk, _options.lenient),
      _server(soup_server_new("server-header", "zelqo-service", nullptr)) {}

Server::~Server() {
  soup_server_disconnect(_server.get());
}

bool Server::start() {
  if (!_blobs.open() || !_catalog.open(_options.data + "/service.db") || !setUpTls()) return false;
  soup_server_add_early_handler(_server.get(), nullptr, headersReadCb, this, nullptr);
  soup_server_add_handler(_server.get(), nullptr, requestCb, this, nullptr);
  const Ref<GSocketAddress> address(
      g_inet_socket_address_new_from_string("127.0.0.1", _options.port));
  const auto flags =
      _options.tlsCertificate.empty() ? SoupServerListenOptions{} : SOUP_SERVER_LISTEN_HTTPS;
  ErrorOut error;
  if (!soup_server_listen(_server.get(), address.get(), flags, error)) {
    g_warning("cannot listen: %s", error.message());
    return false;
  }
  _desk.resume();
  return true;
}

bool Server::setUpTls() {
  if (_options.tlsCertificate.empty()) return true;
  ErrorOut error;
  const Ref<GTlsCertificate> certificate(g_tls_certificate_new_from_files(
      _options.tlsCertificate.c_str(), _options.tlsKey.c_str(), error));
  if (!certificate) {
    g_warning("cannot use the certificate: %s", error.message());
    return false;
  }
  soup_server_set_tls_certificate(_server.get(), certificate.get());
  return true;
}

std::string Server::url() const {
  GSList* uris = soup_server_get_uris(_server.get());
  std::string url;
  if (uris) {
    const Text text(g_uri_to_string(static_cast<GUri*>(uris->data)));
    url = text.get();
  }
  g_slist_free_full(uris, reinterpret_cast<GDestroyNotify>(g_uri_unref));
  if (!url.empty() && url.back() == '/') url.pop_back();
  return url;
}

void Server::headersReadCb(SoupServer*, SoupServerMessage* message, const char*, GHashTable*,
                           gpointer self) {
  auto* server = static_cast<Server*>(self);
  const std::vector<std::string> path = addressWords(message);
  if (server->_options.refuse && !isStats(path)) {
    answerError(message, SOUP_STATUS_FORBIDDEN, "refused");
  } else {
    server->_writeSide.prepare(message, path);
  }
  // What is refused already is still read to its end, but need not be kept.
  if (soup_server_message_get_status(message) != 0) {
    soup_message_body_set_accumulate(soup_server_message_get_request_body(message), FALSE);
  }
}

void Server::requestCb(SoupServer*, SoupServerMessage* message, const char*, GHashTable* query,
                       gpointer self) {
  auto* server = static_cast<Server*>(self);
  std::vector<std::string> path = addressWords(message);
  if (isStats(path)) {
    server->answerStats(message);
  } else if (server->_options.delayMs > 0) {
    server->answerLater(message, std::move(path), query);
  } else {
    server->answer(message, path, query);
  }
}

bool Server::answer(SoupServerMessage* message, const std::vector<std::string>& path,
                    GHashTable* query) {
  if (!path.empty() && path[0] == "v1") return _writeSide.answer(message, path, query);
  if (!path.empty() && path[0] == "share") {
    _readSide.answer(message, path);
  } else {
    answerError(message, SOUP_STATUS_NOT_FOUND, "nothing here");
  }
  return true;
}

void Server::answerLater(SoupServerMessage* message, std::vector<std::string> path,
                         GHashTable* query) {
  _delayed.remove_if([](const HeldRequest& held) { return !held.message(); });
  HeldRequest& held = _delayed.emplace_back(message);
  const std::shared_ptr<GHashTable> kept(query ? g_hash_table_ref(query) : nullptr,
                                         [](GHashTable* table) {
                                           if (table) g_hash_table_unref(table);
                                         });
  held.after(_options.delayMs, [this, &held, path = std::move(path), kept] {
    if (answer(held.message(), path, kept.get())) {
      held.release();
    } else {
      held.forget();
    }
  });
}

void Server::answerStats(SoupServerMessage* message) const {
  common::JsonWriter json;
  json.open().number("manifest", _stats.manifests);
  for (const BlobKind kind : {BlobKind::File, BlobKind::Thumb, BlobKind::Mid, BlobKind::Big}) {
    json.number(blobWord(kind), _stats.blobs.at(static_cast<std::size_t>(kind)));
  }
  answerJson(message, SOUP_STATUS_OK, json.number("file_bytes", _stats.fileBytes).close().str());
}

}  // namespace service
