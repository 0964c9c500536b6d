#include "Upload.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>

namespace service {
namespace {

constexpr char kDataKey[] = "service-upload";
constexpr mode_t kMode = 0600;

unsigned nextUpload() {
  static unsigned number = 0;
  return number++;
}

}  // namespace

void Upload::attach(SoupServerMessage* message, const std::string& incoming, std::int64_t expected,
                    std::int64_t limit) {
  auto* upload = new Upload(incoming, expected, limit);
  g_object_set_data_full(G_OBJECT(message), kDataKey, upload,
                         [](gpointer self) { delete static_cast<Upload*>(self); });
  soup_message_body_set_accumulate(soup_server_message_get_request_body(message), FALSE);
  g_signal_connect(message, "got-chunk", G_CALLBACK(gotChunkCb), upload);
}

Upload* Upload::of(SoupServerMessage* message) {
  return static_cast<Upload*>(g_object_get_data(G_OBJECT(message), kDataKey));
}

Upload::Upload(const std::string& incoming, std::int64_t expected, std::int64_t limit)
    : _part(incoming + "/" + std::to_string(nextUpload())),
      _expected(expected),
      _limit(limit),
      _fd(::open(_part.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, kMode)) {
  if (!_fd.valid()) g_warning("upload: cannot create %s: %s", _part.c_str(), g_strerror(errno));
}

Upload::~Upload() {
  if (!_part.empty()) unlink(_part.c_str());
}

void Upload::gotChunkCb(SoupServerMessage*, GBytes* chunk, gpointer self) {
  static_cast<Upload*>(self)->write(chunk);
}

void Upload::write(GBytes* chunk) {
  gsize size = 0;
  const auto* data = static_cast<const char*>(g_bytes_get_data(chunk, &size));
  _tooLong = _tooLong || static_cast<std::int64_t>(size) > _limit - _written;
  while (_fd.valid() && !_tooLong && size > 0) {
    const ssize_t count = ::write(_fd.get(), data, size);
    if (count < 0 && errno == EINTR) continue;
    if (count <= 0) {
      g_warning("upload: %s", g_strerror(errno));
      _fd.close();
      return;
    }
    data += count;
    size -= static_cast<gsize>(count);
    _written += count;
  }
}

Upload::Result Upload::finish(const std::string& path) {
  if (_tooLong) return Result::TooLong;
  if (!_fd.valid()) return Result::DiskError;
  if (_expected >= 0 && _written != _expected) return Result::TooShort;
  _fd.close();
  if (rename(_part.c_str(), path.c_str()) != 0) {
    g_warning("upload: %s", g_strerror(errno));
    return Result::DiskError;
  }
  _part.clear();
  return Result::Complete;
}

}  // namespace service
