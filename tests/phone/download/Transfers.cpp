#include "Transfers.h"

#include <sys/socket.h>

#include <algorithm>
#include <filesystem>
#include <fstream>

#include "DownloadPage.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

constexpr size_t kPiece = size_t{64} * 1024;

// Ends the reads and writes of other threads, too.
void hangUp(GSocketConnection* connection) {
  g_socket_shutdown(g_socket_connection_get_socket(connection), TRUE, TRUE, nullptr);
}

gssize receive(GSocketConnection* from, std::string& piece, GCancellable* end) {
  piece.resize(kPiece);
  return g_input_stream_read(g_io_stream_get_input_stream(G_IO_STREAM(from)), piece.data(), kPiece,
                             end, nullptr);
}

bool send(GSocketConnection* to, const char* bytes, size_t count, GCancellable* end) {
  return g_output_stream_write_all(g_io_stream_get_output_stream(G_IO_STREAM(to)), bytes, count,
                                   nullptr, end, nullptr);
}

// What comes before the file itself.
constexpr size_t kMostOfHead = 4096;

void passQuestions(GSocketConnection* from, GSocketConnection* to, GCancellable* end) {
  std::string piece;
  for (gssize size; (size = receive(from, piece, end)) > 0;) {
    if (!send(to, piece.data(), static_cast<size_t>(size), end)) break;
  }
  hangUp(to);
}

size_t arrived() {
  size_t bytes = 0;
  for (const auto& file : fs::directory_iterator(ofPhone(kFolder))) {
    if (file.path().extension() == ".part") bytes += file.file_size();
  }
  return bytes;
}

}  // namespace

std::string makeLargeFile(const std::string& name, size_t megabytes) {
  constexpr size_t kStretch = 512;
  std::string path = thePhone().makeFile(name, 0);
  std::ofstream file(path, std::ios::binary);
  std::string block(kMegabyte, '\0');
  for (size_t i = 0; i < megabytes; i++) {
    for (size_t at = 0; at < block.size(); at += kStretch) {
      const size_t stamp = i * kMegabyte + at;
      block.replace(at, sizeof stamp, reinterpret_cast<const char*>(&stamp), sizeof stamp);
    }
    file << block;
  }
  return path;
}

Gate::Gate(size_t bytes)
    : _bytes(bytes), _listener(g_socket_listener_new()), _end(g_cancellable_new()) {
  _port = g_socket_listener_add_any_inet_port(_listener.get(), nullptr, nullptr);
  _acceptor = std::thread([this] { _accept(); });
}

Gate::~Gate() {
  g_cancellable_cancel(_end.get());
  open();
  _acceptor.join();
  for (auto& connection : _connections) connection.join();
}

Share Gate::share(const std::string& name, size_t megabytes) const {
  const Share real = thePhone().share({makeLargeFile(name, megabytes)});
  return announced(R"([{"name":")" + name + R"(","size":)" + std::to_string(megabytes * kMegabyte) +
                   R"(,"type":"video/mp4","url":"http://127.0.0.1:)" + std::to_string(_port) +
                   "/share/" + real.token + R"(/file/0"}])");
}

testing::AssertionResult Gate::isReached() const {
  if (waitFor([this] { return arrived() + kMostOfHead >= _bytes; })) {
    return testing::AssertionSuccess();
  }
  return testing::AssertionFailure() << arrived() << " bytes on\n" << thePhone().tree();
}

void Gate::open() {
  const std::lock_guard<std::mutex> lock(_mutex);
  _isOpen = true;
  _changed.notify_all();
}

void Gate::_accept() {
  for (;;) {
    const std::shared_ptr<GSocketConnection> client(
        g_socket_listener_accept(_listener.get(), nullptr, _end.get(), nullptr), [](auto* one) {
          if (one) g_object_unref(one);
        });
    if (!client) return;
    _connections.emplace_back([this, client] { _serve(client.get()); });
  }
}

void Gate::_serve(GSocketConnection* client) {
  const std::unique_ptr<GSocketClient, Release> caller(g_socket_client_new());
  const std::string address = serviceAddress().substr(std::string("http://").size());
  const std::unique_ptr<GSocketConnection, Release> service(
      g_socket_client_connect_to_host(caller.get(), address.c_str(), 0, _end.get(), nullptr));
  if (service) {
    // Else the service would send on into the system's buffers while nothing passes.
    g_socket_set_option(g_socket_connection_get_socket(service.get()), SOL_SOCKET, SO_RCVBUF,
                        static_cast<gint>(kPiece), nullptr);
    std::thread questions([&] { passQuestions(client, service.get(), _end.get()); });
    _passAnswers(service.get(), client);
    hangUp(client);
    questions.join();
  }
  hangUp(client);
}

void Gate::_passAnswers(GSocketConnection* from, GSocketConnection* to) {
  std::string piece;
  for (gssize size; (size = receive(from, piece, _end.get())) > 0;) {
    for (size_t at = 0, all = static_cast<size_t>(size); at < all;) {
      const size_t count = _mayPass(all - at);
      if (!send(to, piece.data() + at, count, _end.get())) return;
      at += count;
    }
  }
}

size_t Gate::_mayPass(size_t bytes) {
  std::unique_lock<std::mutex> lock(_mutex);
  _changed.wait(lock, [this] { return _isOpen || _passed < _bytes; });
  const size_t count = _isOpen ? bytes : std::min(bytes, _bytes - _passed);
  _passed += count;
  return count;
}

void killDownloadApplication() {
  thePhone().end({"download-manager"}, "KILL");
}
