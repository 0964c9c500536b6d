#include "FakeServer.h"

#include <utility>

FakeServer::FakeServer(Handler handler)
    : _handler(std::move(handler)), _server(soup_server_new(nullptr, nullptr)) {
  soup_server_add_handler(_server, nullptr, requestCb, this, nullptr);
  soup_server_listen_local(_server, 0, SOUP_SERVER_LISTEN_IPV4_ONLY, nullptr);
  GSList* uris = soup_server_get_uris(_server);
  _url = "http://127.0.0.1:" + std::to_string(g_uri_get_port(static_cast<GUri*>(uris->data)));
  g_slist_free_full(uris, reinterpret_cast<GDestroyNotify>(g_uri_unref));
}

FakeServer::~FakeServer() {
  soup_server_disconnect(_server);
  g_object_unref(_server);
}

void FakeServer::requestCb(SoupServer*, SoupServerMessage* message, const char* path, GHashTable*,
                           gpointer self) {
  auto* server = static_cast<FakeServer*>(self);
  server->_requests++;
  server->_handler(message, path);
}

void answerWith(SoupServerMessage* message, unsigned status, const std::string& body) {
  soup_server_message_set_status(message, status, nullptr);
  soup_server_message_set_response(message, "application/octet-stream", SOUP_MEMORY_COPY,
                                   body.data(), body.size());
}
