#pragma once

#include <stddef.h>
#include <stdint.h>
#include <unistd.h>

#include <cstdlib>

/// One file per fuzzing process whose content is the input, rewritten for each run.
class TemporaryFile {
 public:
  TemporaryFile() : _fd(mkstemp(_path)) {}
  ~TemporaryFile() {
    close(_fd);
    unlink(_path);
  }
  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;

  void write(const uint8_t* data, size_t size) {
    if (ftruncate(_fd, 0) != 0 || pwrite(_fd, data, size, 0) < 0) abort();
  }
  const char* path() const { return _path; }

 private:
  char _path[32] = "/dev/shm/zelqo-fuzz-XXXXXX";
  int _fd;
};
