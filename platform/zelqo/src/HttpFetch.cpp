#include "HttpFetch.h"

#include <utility>

namespace zelqo {
namespace {

constexpr gsize kPiece = 64 << 10;
constexpr guint kFirstErrorStatus = 400;
constexpr guint kFirstServerError = 500;

}  // namespace

SessionOwner makeSession(int connections, guint inactivityS) {
  return SessionOwner(soup_session_new_with_options("max-conns", connections, "max-conns-per-host",
                                                    connections, "timeout", inactivityS,
                                                    "user-agent", "zelqo", nullptr));
}

MessageOwner makeMessage(const char* method, const std::string& url) {
  if (url.rfind("http://", 0) != 0 && url.rfind("https://", 0) != 0) return nullptr;
  const common::Owned<GUri, g_uri_unref> uri(
      g_uri_parse(url.c_str(), static_cast<GUriFlags>(SOUP_HTTP_URI_FLAGS), nullptr));
  const char* host = uri ? g_uri_get_host(uri.get()) : nullptr;
  return MessageOwner(host && *host ? soup_message_new_from_uri(method, uri.get()) : nullptr);
}

HttpFetch::HttpFetch(SoupSession* session, MessageOwner message, Limits limits, Sink sink,
                     Done done)
    : _message(std::move(message)),
      _limits(limits),
      _sink(std::move(sink)),
      _done(std::move(done)),
      _loan(new Loan{this, std::unique_ptr<char[]>(new char[kPiece])}),
      _cancellable(g_cancellable_new()),
      _deadline(callAfter(limits.deadlineMs, deadlineCb, this)) {
  soup_session_send_async(session, _message.get(), G_PRIORITY_DEFAULT, _cancellable.get(), sentCb,
                          lend());
}

HttpFetch::~HttpFetch() {
  _loan->fetch = nullptr;
  g_cancellable_cancel(_cancellable.get());
}

HttpFetch* HttpFetch::claim(gpointer data) {
  const std::unique_ptr<std::shared_ptr<Loan>> loan(static_cast<std::shared_ptr<Loan>*>(data));
  return (*loan)->fetch;
}

void HttpFetch::sentCb(GObject* session, GAsyncResult* result, gpointer data) {
  common::OwnedError error;
  common::Owned<GInputStream, g_object_unref> stream(
      soup_session_send_finish(SOUP_SESSION(session), result, common::Out(error)));
  HttpFetch* fetch = claim(data);
  if (!fetch) return;
  if (!stream) {
    fetch->finish(ZELQO_ERROR_NETWORK, error ? error->message : "no answer");
    return;
  }
  fetch->_stream = std::move(stream);
  fetch->readMore();
}

void HttpFetch::readMore() {
  g_input_stream_read_async(_stream.get(), _loan->piece.get(), kPiece, G_PRIORITY_DEFAULT,
                            _cancellable.get(), readCb, lend());
}

void HttpFetch::readCb(GObject* stream, GAsyncResult* result, gpointer data) {
  common::OwnedError error;
  const gssize size =
      g_input_stream_read_finish(G_INPUT_STREAM(stream), result, common::Out(error));
  HttpFetch* fetch = claim(data);
  if (!fetch) return;
  if (size < 0) {
    fetch->finish(ZELQO_ERROR_NETWORK, error ? error->message : "the answer broke off");
  } else {
    fetch->take(static_cast<gsize>(size));
  }
}

void HttpFetch::take(gsize size) {
  if (size == 0) {
    finish(statusError(), soup_message_get_reason_phrase(_message.get()));
    return;
  }
  _received += static_cast<goffset>(size);
  if (_received > _limits.size) {
    finish(ZELQO_ERROR_REFUSED, "the answer is too long");
  } else if (!_sink(soup_message_get_status(_message.get()), _loan->piece.get(), size)) {
    finish(ZELQO_ERROR_STORE, "the answer cannot be kept");
  } else {
    readMore();
  }
}

zelqo_error_e HttpFetch::statusError() const {
  const guint status = soup_message_get_status(_message.get());
  if (status < kFirstErrorStatus) return ZELQO_ERROR_NONE;
  if (status == SOUP_STATUS_GONE) return ZELQO_ERROR_GONE;
  if (status == SOUP_STATUS_NOT_FOUND) return ZELQO_ERROR_NO_DATA;
  return status >= kFirstServerError ? ZELQO_ERROR_NETWORK : ZELQO_ERROR_REFUSED;
}

gboolean HttpFetch::deadlineCb(gpointer self) {
  auto* fetch = static_cast<HttpFetch*>(self);
  fetch->finish(ZELQO_ERROR_NETWORK, "no whole answer in time");
  return G_SOURCE_REMOVE;
}

void HttpFetch::finish(zelqo_error_e error, const std::string& reason) {
  _loan->fetch = nullptr;
  _deadline.reset();
  g_cancellable_cancel(_cancellable.get());
  const Outcome outcome{error, soup_message_get_status(_message.get()), reason};
  const Done done = std::move(_done);
  done(outcome);
}

}  // namespace zelqo
