#include "TestServer.h"

#include <cstdlib>

namespace {

GTlsCertificate* makeCertificate(const std::string& folder) {
  const std::string key = folder + "/key.pem";
  const std::string certificate = folder + "/cert.pem";
  const std::string make =
      "openssl req -x509 -newkey rsa:2048 -nodes -days 2 -subj /CN=127.0.0.1 "
      "-addext subjectAltName=IP:127.0.0.1 -keyout " +
      key + " -out " + certificate + " >/dev/null 2>&1 </dev/null";
  if (system(make.c_str()) != 0) return nullptr;
  return g_tls_certificate_new_from_files(certificate.c_str(), key.c_str(), nullptr);
}

}  // namespace

TestServer::TestServer() : _server(soup_server_new(nullptr, nullptr)) {
  _listen(SOUP_SERVER_LISTEN_IPV4_ONLY);
}

TestServer::TestServer(const std::string& certificateFolder)
    : _server(soup_server_new(nullptr, nullptr)) {
  GTlsCertificate* certificate = makeCertificate(certificateFolder);
  soup_server_set_tls_certificate(_server, certificate);
  g_clear_object(&certificate);
  _listen(static_cast<SoupServerListenOptions>(SOUP_SERVER_LISTEN_IPV4_ONLY |
                                               SOUP_SERVER_LISTEN_HTTPS));
}

void TestServer::_listen(SoupServerListenOptions options) {
  soup_server_listen_local(_server, 0, options, nullptr);
  GSList* uris = soup_server_get_uris(_server);
  gchar* text = g_uri_to_string(static_cast<GUri*>(uris->data));
  _base = text;
  _base.pop_back();
  g_free(text);
  g_slist_free_full(uris, reinterpret_cast<GDestroyNotify>(g_uri_unref));
  soup_server_add_handler(_server, nullptr, _handleCb, this, nullptr);
}

TestServer::~TestServer() {
  soup_server_disconnect(_server);
  g_object_unref(_server);
}

void TestServer::_handleCb(SoupServer*, SoupServerMessage* message, const char* path, GHashTable*,
                           gpointer data) {
  static_cast<TestServer*>(data)->_handle(message, path);
}

void TestServer::_wroteBodyDataCb(SoupServerMessage*, guint count, gpointer data) {
  static_cast<TestServer*>(data)->_bytesServed += count;
}

void TestServer::_handle(SoupServerMessage* message, const std::string& path) {
  _requests++;
  const Answer& answer = _answers[path];
  SoupMessageHeaders* asked = soup_server_message_get_request_headers(message);
  SoupMessageHeaders* head = soup_server_message_get_response_headers(message);
  const char* range = soup_message_headers_get_one(asked, "Range");
  _lastRange = range ? range : "";
  g_signal_connect(message, "wrote-body-data", G_CALLBACK(_wroteBodyDataCb), this);
  if (!answer.location.empty()) {
    soup_server_message_set_redirect(message, SOUP_STATUS_FOUND, url(answer.location).c_str());
    return;
  }
  const char* ifRange = soup_message_headers_get_one(asked, "If-Range");
  if (ifRange && answer.etag != ifRange) soup_message_headers_remove(asked, "Range");
  soup_server_message_set_status(message, answer.status, nullptr);
  if (!answer.etag.empty()) soup_message_headers_append(head, "ETag", answer.etag.c_str());
  if (answer.isStuck || answer.isCutOff) {
    _sendHalf(message, answer);
    return;
  }
  if (answer.isChunked) {
    soup_message_headers_set_encoding(head, SOUP_ENCODING_CHUNKED);
  }
  soup_message_body_append(soup_server_message_get_response_body(message), SOUP_MEMORY_COPY,
                           answer.body.data(), answer.body.size());
  soup_message_body_complete(soup_server_message_get_response_body(message));
}

void TestServer::_sendHalf(SoupServerMessage* message, const Answer& answer) {
  soup_message_headers_set_content_length(soup_server_message_get_response_headers(message),
                                          static_cast<goffset>(answer.body.size()));
  soup_message_body_append(soup_server_message_get_response_body(message), SOUP_MEMORY_COPY,
                           answer.body.data(), answer.body.size() / 2);
  if (!answer.isCutOff) return;
  g_signal_connect(message, "wrote-chunk", G_CALLBACK(+[](SoupServerMessage* sent, gpointer) {
                     g_socket_shutdown(soup_server_message_get_socket(sent), TRUE, TRUE, nullptr);
                   }),
                   nullptr);
}
