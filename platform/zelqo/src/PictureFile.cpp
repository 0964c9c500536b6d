#include "PictureFile.h"

#include <common/Owned.h>
#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <ctime>
#include <utility>

#include "PictureKind.h"

namespace zelqo {
namespace {

constexpr mode_t kMode = 0644;
constexpr char kPartSuffix[] = ".part";
constexpr time_t kLeftoverAgeS = 600;
constexpr std::size_t kHashDigits = 40;

std::string hashOf(const std::string& url) {
  const common::OwnedText sum(g_compute_checksum_for_string(G_CHECKSUM_SHA256, url.c_str(), -1));
  return std::string(sum.get()).substr(0, kHashDigits);
}

std::string partName(const std::string& hash) {
  static unsigned number = 0;
  return "." + hash + "." + std::to_string(getpid()) + "-" + std::to_string(number++) + kPartSuffix;
}

}  // namespace

PictureFile::PictureFile(std::string folder, const std::string& url)
    : _folder(std::move(folder)),
      _hash(hashOf(url)),
      _part(_folder + "/" + partName(_hash)),
      _fd(open(_part.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_NOFOLLOW | O_CLOEXEC, kMode)) {
  if (_fd < 0) g_warning("zelqo: cannot create %s: %s", _part.c_str(), g_strerror(errno));
}

PictureFile::~PictureFile() {
  if (_fd < 0) return;
  close(_fd);
  if (_path.empty()) unlink(_part.c_str());
}

bool PictureFile::write(const char* data, std::size_t size) {
  if (_fd < 0) return false;
  if (_head.size() < kPictureMagicSize) {
    _head.append(data, std::min(size, kPictureMagicSize - _head.size()));
  }
  while (size > 0) {
    const ssize_t count = ::write(_fd, data, size);
    if (count < 0 && errno == EINTR) continue;
    if (count <= 0) {
      g_warning("zelqo: cannot write %s: %s", _part.c_str(), g_strerror(errno));
      return false;
    }
    data += count;
    size -= static_cast<std::size_t>(count);
  }
  return true;
}

PictureFile::Result PictureFile::finish() {
  const char* extension = pictureExtension(_head.data(), _head.size());
  if (!extension) return Result::NoPicture;
  const std::string path = _folder + "/" + _hash + extension;
  if (_fd < 0 || rename(_part.c_str(), path.c_str()) != 0) {
    g_warning("zelqo: cannot name %s: %s", path.c_str(), g_strerror(errno));
    return Result::Failed;
  }
  _path = path;
  return Result::Whole;
}

void PictureFile::removeLeftovers(const std::string& folder) {
  const common::Owned<DIR, closedir> entries(opendir(folder.c_str()));
  const time_t now = time(nullptr);
  while (const dirent* entry = entries ? readdir(entries.get()) : nullptr) {
    struct stat status;
    if (entry->d_name[0] == '.' && g_str_has_suffix(entry->d_name, kPartSuffix) &&
        fstatat(dirfd(entries.get()), entry->d_name, &status, AT_SYMLINK_NOFOLLOW) == 0 &&
        now - status.st_mtime > kLeftoverAgeS) {
      unlinkat(dirfd(entries.get()), entry->d_name, 0);
    }
  }
}

}  // namespace zelqo
