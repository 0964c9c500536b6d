#include "FilePlacer.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <fstream>
#include <iterator>

#include "FileNamer.h"

namespace downloads {
namespace {

constexpr unsigned int kMaxNumber = 9999;

bool isPlainFile(const std::string& path, off_t* size) {
  struct stat info {};
  if (lstat(path.c_str(), &info) != 0 || !S_ISREG(info.st_mode)) return false;
  *size = info.st_size;
  return true;
}

bool haveSameContent(const std::string& left, const std::string& right) {
  off_t leftSize = 0;
  off_t rightSize = 0;
  if (!isPlainFile(left, &leftSize) || !isPlainFile(right, &rightSize) || leftSize != rightSize) {
    return false;
  }
  std::ifstream a(left, std::ios::binary);
  std::ifstream b(right, std::ios::binary);
  using Bytes = std::istreambuf_iterator<char>;
  return a && b && std::equal(Bytes(a), Bytes(), Bytes(b), Bytes());
}

// The file system may lack the flag; a hard link refuses an existing name as well.
bool renameWithoutReplacing(const std::string& from, const std::string& to) {
  if (renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE) == 0) return true;
  if (errno != EINVAL && errno != ENOSYS) return false;
  return link(from.c_str(), to.c_str()) == 0 && unlink(from.c_str()) == 0;
}

bool isReplaceable(const std::string& path, const std::string& folder) {
  off_t size = 0;
  return path.compare(0, folder.size() + 1, folder + "/") == 0 &&
         path.find('/', folder.size() + 1) == std::string::npos && isPlainFile(path, &size);
}

}  // namespace

std::string placeFile(const std::string& partPath, const std::string& folder,
                      const std::string& name, const std::string& earlierPath) {
  if (isReplaceable(earlierPath, folder) && rename(partPath.c_str(), earlierPath.c_str()) == 0) {
    return earlierPath;
  }
  const std::string safe = safeName(name);
  for (unsigned int n = 0; n <= kMaxNumber; n++) {
    const std::string path = folder + "/" + numberedName(safe, n);
    if (renameWithoutReplacing(partPath, path)) return path;
    if (errno != EEXIST) return {};
    if (haveSameContent(partPath, path)) {
      unlink(partPath.c_str());
      return path;
    }
  }
  return {};
}

}  // namespace downloads
