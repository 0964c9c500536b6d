/// Owners of the C handles that the service uses.
#pragma once

#include <common/Owned.h>

#include <utility>

namespace service {

using common::Owned;
using common::refer;
using Text = common::OwnedText;
using Bytes = common::OwnedBytes;
using MappedFile = Owned<GMappedFile, g_mapped_file_unref>;
using Checksum = Owned<GChecksum, g_checksum_free>;
template <typename T>
using Ref = common::OwnedObject<T>;

/// Passed to a C function that answers with a new GError.
class ErrorOut {
 public:
  ErrorOut() = default;
  ErrorOut(const ErrorOut&) = delete;
  ErrorOut& operator=(const ErrorOut&) = delete;
  ~ErrorOut() { g_clear_error(&_error); }
  operator GError**() { return &_error; }
  const char* message() const { return _error ? _error->message : "unknown error"; }

 private:
  GError* _error = nullptr;
};

/// A file descriptor.
class Fd {
 public:
  explicit Fd(int fd = -1) : _fd(fd) {}
  Fd(Fd&& other) noexcept : _fd(std::exchange(other._fd, -1)) {}
  Fd& operator=(Fd&& other) noexcept {
    std::swap(_fd, other._fd);
    return *this;
  }
  ~Fd();
  int get() const { return _fd; }
  bool valid() const { return _fd >= 0; }
  void close();

 private:
  int _fd;
};

}  // namespace service
