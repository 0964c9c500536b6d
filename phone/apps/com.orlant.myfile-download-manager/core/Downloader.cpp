#include "Downloader.h"

#include <sys/socket.h>

#include "PartFile.h"

namespace downloads {
namespace {

constexpr gsize kChunkBytes = 256 * 1024;
// What has come as far as the system's buffers is lost when the application is killed, and asked
// for again. Left alone, they may grow to tens of megabytes.
constexpr gint kBufferBytes = 1024 * 1024;

// A weak tag promises the same meaning, not the same bytes.
bool isStrong(const std::string& etag) {
  return !etag.empty() && etag.compare(0, 2, "W/") != 0;
}

Failure failureOfStatus(unsigned int status) {
  return status == SOUP_STATUS_NOT_FOUND || status == SOUP_STATUS_GONE ? Failure::Gone
                                                                       : Failure::Refused;
}

Failure failureOfError(const GError* error) {
  // A redirect loop, or something that is not HTTP.
  if (error->domain == SOUP_SESSION_ERROR) return Failure::Refused;
  return Failure::Network;
}

void connectingCb(SoupMessage*, GSocketClientEvent event, GIOStream* connection, gpointer) {
  if (event != G_SOCKET_CLIENT_CONNECTING || !G_IS_SOCKET_CONNECTION(connection)) return;
  GSocket* socket = g_socket_connection_get_socket(G_SOCKET_CONNECTION(connection));
  g_socket_set_option(socket, SOL_SOCKET, SO_RCVBUF, kBufferBytes, nullptr);
}

}  // namespace

Downloader::Downloader(SoupSession* session, Job job, Listener listener)
    : _session(static_cast<SoupSession*>(g_object_ref(session))),
      _job(std::move(job)),
      _listener(std::move(listener)),
      _cancellable(g_cancellable_new()),
      _self(std::make_shared<Downloader*>(this)) {}

Downloader::~Downloader() {
  g_cancellable_cancel(_cancellable.get());
  if (_silenceSource) g_source_remove(_silenceSource);
  if (_endSource) g_source_remove(_endSource);
}

void Downloader::start() {
  const Failure failure = _prepare();
  if (failure != Failure::None) {
    _endLater(failure);
  } else if (_job.size > 0 && _part->size() == _job.size && isStrong(_job.etag)) {
    _endLater(Failure::None);  // killed between the last byte and the final name
  } else {
    _request();
  }
}

Failure Downloader::_prepare() {
  _part = std::make_unique<PartFile>(_job.partPath);
  if (!_part->isOpen()) return _part->openFailure();
  const bool isUseful = isStrong(_job.etag) && (_job.size == 0 || _part->size() <= _job.size);
  if (_part->size() > 0 && !isUseful) return _part->startOver();
  return Failure::None;
}

void Downloader::_request() {
  _message.reset(soup_message_new(SOUP_METHOD_GET, _job.url.c_str()));
  if (!_message) {
    _endLater(Failure::Address);
    return;
  }
  SoupMessageHeaders* headers = soup_message_get_request_headers(_message.get());
  // A compressed body would have other lengths and ranges than the file.
  soup_message_headers_replace(headers, "Accept-Encoding", "identity");
  if (_part->size() > 0) {
    soup_message_headers_set_range(headers, static_cast<goffset>(_part->size()), -1);
    soup_message_headers_replace(headers, "If-Range", _job.etag.c_str());
  }
  g_signal_connect(_message.get(), "network-event", G_CALLBACK(connectingCb), nullptr);
  _watchSilence();
  soup_session_send_async(_session.get(), _message.get(), G_PRIORITY_DEFAULT, _cancellable.get(),
                          _answeredCb, new Link(_self));
}

void Downloader::_answeredCb(GObject* session, GAsyncResult* result, gpointer data) {
  GError* raw = nullptr;
  common::OwnedObject<GInputStream> stream(
      soup_session_send_finish(SOUP_SESSION(session), result, &raw));
  const common::OwnedError error(raw);
  const std::unique_ptr<Link> link(static_cast<Link*>(data));
  if (const auto self = link->lock()) (*self)->_answered(stream.release(), raw);
}

void Downloader::_answered(GInputStream* stream, GError* error) {
  _stream.reset(stream);
  if (error) {
    _end(failureOfError(error));
    return;
  }
  const unsigned int status = soup_message_get_status(_message.get());
  if (status == SOUP_STATUS_REQUESTED_RANGE_NOT_SATISFIABLE && !_triedWithoutRange) {
    _triedWithoutRange = true;
    const Failure failure = _part->startOver();
    failure == Failure::None ? _request() : _end(failure);
    return;
  }
  const Failure failure = _accept(status);
  if (failure != Failure::None) {
    _end(failure);
    return;
  }
  const char* etag =
      soup_message_headers_get_one(soup_message_get_response_headers(_message.get()), "ETag");
  _job.etag = etag ? etag : "";
  _listener.begun(_job.etag);
  _readMore();
}

Failure Downloader::_accept(unsigned int status) {
  if (status == SOUP_STATUS_PARTIAL_CONTENT) return _acceptRest();
  if (status == SOUP_STATUS_OK) return _acceptWhole();
  return failureOfStatus(status);
}

Failure Downloader::_acceptRest() {
  goffset start = 0;
  goffset end = 0;
  goffset total = 0;
  if (!soup_message_headers_get_content_range(soup_message_get_response_headers(_message.get()),
                                              &start, &end, &total) ||
      start != static_cast<goffset>(_part->size()) || end < start) {
    return Failure::Refused;
  }
  return _checkLength(static_cast<std::uint64_t>(end - start + 1));
}

Failure Downloader::_acceptWhole() {
  const Failure failure = _part->size() > 0 ? _part->startOver() : Failure::None;
  if (failure != Failure::None) return failure;
  SoupMessageHeaders* headers = soup_message_get_response_headers(_message.get());
  if (soup_message_headers_get_encoding(headers) != SOUP_ENCODING_CONTENT_LENGTH) {
    return _checkLength(_job.size);
  }
  const goffset length = soup_message_headers_get_content_length(headers);
  return _checkLength(static_cast<std::uint64_t>(length));
}

Failure Downloader::_checkLength(std::uint64_t remaining) {
  const std::uint64_t whole = _part->size() + remaining;
  if (_job.size > 0 && whole != _job.size) return Failure::WrongSize;
  _total = whole;
  return _part->hasRoomFor(remaining) ? Failure::None : Failure::DiskFull;
}

void Downloader::_readMore() {
  _watchSilence();
  g_input_stream_read_bytes_async(_stream.get(), kChunkBytes, G_PRIORITY_DEFAULT,
                                  _cancellable.get(), _readCb, new Link(_self));
}

void Downloader::_readCb(GObject* stream, GAsyncResult* result, gpointer data) {
  GError* raw = nullptr;
  const common::OwnedBytes bytes(
      g_input_stream_read_bytes_finish(G_INPUT_STREAM(stream), result, &raw));
  const common::OwnedError error(raw);
  const std::unique_ptr<Link> link(static_cast<Link*>(data));
  if (const auto self = link->lock()) (*self)->_received(bytes.get(), raw);
}

void Downloader::_received(GBytes* bytes, GError* error) {
  if (error) {
    _end(failureOfError(error));
    return;
  }
  gsize count = 0;
  const void* data = g_bytes_get_data(bytes, &count);
  if (count == 0) {
    _end(_total == 0 || _part->size() == _total ? Failure::None : Failure::WrongSize);
    return;
  }
  if (_total > 0 && _part->size() + count > _total) {
    _part->startOver();  // what is there may be whole by its length, and is still not the file
    _end(Failure::WrongSize);
    return;
  }
  const Failure failure = _part->append(data, count);
  if (failure != Failure::None) {
    _end(failure);
    return;
  }
  _listener.progressed(_part->size());
  _readMore();
}

void Downloader::_watchSilence() {
  if (_silenceSource) g_source_remove(_silenceSource);
  _silenceSource = g_timeout_add(_job.silenceMs, _silenceCb, this);
}

gboolean Downloader::_silenceCb(gpointer data) {
  auto* self = static_cast<Downloader*>(data);
  self->_silenceSource = 0;
  self->_end(Failure::Silent);
  return G_SOURCE_REMOVE;
}

void Downloader::_endLater(Failure failure) {
  _outcome = failure;
  _endSource = g_idle_add(_endCb, this);
}

gboolean Downloader::_endCb(gpointer data) {
  auto* self = static_cast<Downloader*>(data);
  self->_endSource = 0;
  self->_end(self->_outcome);
  return G_SOURCE_REMOVE;
}

void Downloader::_end(Failure failure) {
  _self.reset();
  _part.reset();
  g_cancellable_cancel(_cancellable.get());
  if (_silenceSource) g_source_remove(_silenceSource);
  _silenceSource = 0;
  const auto ended = std::move(_listener.ended);
  ended(failure);
}

}  // namespace downloads
