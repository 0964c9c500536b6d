#include "PartFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <unistd.h>

#include <cerrno>

#include <common/Owned.h>

namespace downloads {
namespace {

// A limit on the size of files (EFBIG) and a quota leave the user with the same thing to do.
Failure failureOf(int error) {
  const bool full = error == ENOSPC || error == EDQUOT || error == EFBIG;
  return full ? Failure::DiskFull : Failure::Storage;
}

}  // namespace

std::string PartFile::pathFor(const std::string& folder, const std::string& url) {
  const common::OwnedText hash(g_compute_checksum_for_string(G_CHECKSUM_SHA256, url.c_str(), -1));
  return folder + "/." + hash.get() + ".part";
}

PartFile::PartFile(const std::string& path)
    : _fd(::open(path.c_str(), O_WRONLY | O_CREAT | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK, 0644)) {
  struct stat info {};
  if (_fd >= 0 && fstat(_fd, &info) == 0 && S_ISREG(info.st_mode)) {
    _size = static_cast<std::uint64_t>(info.st_size);
    return;
  }
  _openFailure = _fd >= 0 ? Failure::Storage : failureOf(errno);
  if (_fd >= 0) ::close(_fd);
  _fd = -1;
}

PartFile::~PartFile() {
  if (_fd >= 0) ::close(_fd);
}

Failure PartFile::append(const void* bytes, std::size_t count) {
  const char* at = static_cast<const char*>(bytes);
  while (count > 0) {
    const ssize_t written = pwrite(_fd, at, count, static_cast<off_t>(_size));
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) return failureOf(errno);
    at += written;
    count -= static_cast<std::size_t>(written);
    _size += static_cast<std::uint64_t>(written);
  }
  return Failure::None;
}

Failure PartFile::startOver() {
  if (ftruncate(_fd, 0) != 0) return failureOf(errno);
  _size = 0;
  return Failure::None;
}

bool PartFile::hasRoomFor(std::uint64_t bytes) const {
  struct statvfs info {};
  if (fstatvfs(_fd, &info) != 0) return true;
  return static_cast<std::uint64_t>(info.f_bavail) * info.f_frsize >= bytes;
}

}  // namespace downloads
