/// Owners of the C handles that the service uses.
#pragma once

#include <gio/gio.h>

#include <memory>
#include <utility>

namespace service {

template <auto Release>
struct Releaser {
  template <typename T>
  void operator()(T* handle) const {
    Release(handle);
  }
};

template <typename T, auto Release>
using Owned = std::unique_ptr<T, Releaser<Release>>;

using Text = Owned<char, g_free>;
using Error = Owned<GError, g_error_free>;
using Bytes = Owned<GBytes, g_bytes_unref>;
using MappedFile = Owned<GMappedFile, g_mapped_file_unref>;
using Checksum = Owned<GChecksum, g_checksum_free>;

/// One reference to a GObject.
template <typename T>
using Ref = Owned<T, g_object_unref>;

template <typename T>
Ref<T> refer(T* object) {
  return Ref<T>(static_cast<T*>(g_object_ref(object)));
}

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
