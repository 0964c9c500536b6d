#include "PictureFile.h"

#include <common/Owned.h>
#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
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
  static std::atomic<unsigned> number = 0;
  return "." + hash + "." + std::to_string(getpid()) + "-" + std::to_string(number++) + kPartSuffix;
}

/// A file that is being written; what is not kept is removed.
class Part {
 public:
  explicit Part(std::string path)
      : _path(std::move(path)),
        _fd(open(_path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_NOFOLLOW | O_CLOEXEC, kMode)) {
    if (_fd < 0) g_warning("zelqo: cannot create %s: %s", _path.c_str(), g_strerror(errno));
  }
  ~Part() {
    if (_fd < 0) return;
    close(_fd);
    if (!_isKept) unlink(_path.c_str());
  }
  Part(const Part&) = delete;
  Part& operator=(const Part&) = delete;

  bool write(const char* data, std::size_t size) const {
    if (_fd < 0) return false;
    while (size > 0) {
      const ssize_t count = ::write(_fd, data, size);
      if (count < 0 && errno == EINTR) continue;
      if (count <= 0) {
        g_warning("zelqo: cannot write %s: %s", _path.c_str(), g_strerror(errno));
        return false;
      }
      data += count;
      size -= static_cast<std::size_t>(count);
    }
    return true;
  }

  bool keepAs(const std::string& path) {
    _isKept = rename(_path.c_str(), path.c_str()) == 0;
    if (!_isKept) g_warning("zelqo: cannot name %s: %s", path.c_str(), g_strerror(errno));
    return _isKept;
  }

 private:
  std::string _path;
  int _fd;
  bool _isKept = false;
};

}  // namespace

PictureSaved savePicture(const std::string& folder, const std::string& url,
                         const std::string& content, std::string& path) {
  const char* extension = pictureExtension(content.data(), content.size());
  if (!extension) return PictureSaved::NoPicture;
  const std::string hash = hashOf(url);
  Part part(folder + "/" + partName(hash));
  const std::string name = folder + "/" + hash + extension;
  if (!part.write(content.data(), content.size()) || !part.keepAs(name)) {
    return PictureSaved::Failed;
  }
  path = name;
  return PictureSaved::Whole;
}

void removePictureLeftovers(const std::string& folder) {
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
