#include <common/DamagedDatabase.h>
#include <common/Database.h>
#include <common/Owned.h>
#include <fcntl.h>
#include <sqlite3.h>
#include <sys/file.h>
#include <unistd.h>

#include <cstdio>
#include <string_view>

namespace common {
namespace {

/// Locks the folder, so that no lock file stays behind.
class FolderLock {
 public:
  explicit FolderLock(const std::string& folder)
      : _fd(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC)) {
    if (_fd >= 0) flock(_fd, LOCK_EX);
  }
  ~FolderLock() {
    if (_fd >= 0) close(_fd);
  }
  FolderLock(const FolderLock&) = delete;
  FolderLock& operator=(const FolderLock&) = delete;

 private:
  int _fd;
};

// A fresh connection: what an open one says depends on what it has read before.
int checked(const std::string& path) {
  sqlite3* handle = nullptr;
  int result = openSharedFile(path, SQLITE_OPEN_READWRITE, &handle);
  const Owned<sqlite3, sqlite3_close> owner(handle);
  if (result != SQLITE_OK) return result;
  sqlite3_stmt* prepared = nullptr;
  result = sqlite3_prepare_v2(handle, "PRAGMA quick_check(1)", -1, &prepared, nullptr);
  const Owned<sqlite3_stmt, sqlite3_finalize> check(prepared);
  if (result == SQLITE_OK) result = sqlite3_step(prepared);
  if (result != SQLITE_ROW) return result;
  const auto* verdict = reinterpret_cast<const char*>(sqlite3_column_text(prepared, 0));
  return verdict && std::string_view(verdict) == "ok" ? SQLITE_OK : SQLITE_CORRUPT;
}

}  // namespace

Examined examineDatabase(const std::string& path, const std::string& aside) {
  const OwnedText folder(g_path_get_dirname(path.c_str()));
  const FolderLock lock(folder.get());
  const int result = checked(path);
  if (result == SQLITE_OK || result == SQLITE_BUSY) return Examined::Sound;
  if (result != SQLITE_CORRUPT && result != SQLITE_NOTADB) return Examined::Unusable;
  if (rename(path.c_str(), aside.c_str()) != 0) return Examined::Unusable;
  for (const char* companion : {"-wal", "-shm"}) {
    rename((path + companion).c_str(), (aside + companion).c_str());
  }
  return Examined::SetAside;
}

}  // namespace common
