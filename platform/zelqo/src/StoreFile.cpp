#include "StoreFile.h"

#include <base/Owned.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>

namespace zelqo {
namespace {

constexpr mode_t kPrivate = 0700;
constexpr mode_t kPrivateFile = 0600;

constexpr char kSchema[] = R"(
CREATE TABLE IF NOT EXISTS received(
  token TEXT PRIMARY KEY, sender TEXT NOT NULL, base TEXT NOT NULL, single INTEGER NOT NULL,
  created_ms INTEGER NOT NULL, expires_ms INTEGER NOT NULL, recalled_ms INTEGER) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS received_file(
  token TEXT NOT NULL, position INTEGER NOT NULL, name TEXT, size INTEGER, type TEXT, url TEXT,
  thumb TEXT, mid TEXT, big TEXT, PRIMARY KEY(token, position)) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS sent(
  request_id INTEGER PRIMARY KEY, token TEXT NOT NULL, sender TEXT NOT NULL,
  single INTEGER NOT NULL, created_ms INTEGER NOT NULL, expires_ms INTEGER NOT NULL,
  recalled_ms INTEGER);
CREATE TABLE IF NOT EXISTS sent_recipient(
  request_id INTEGER NOT NULL, position INTEGER NOT NULL, msisdn TEXT NOT NULL,
  PRIMARY KEY(request_id, position)) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS sent_file(
  request_id INTEGER NOT NULL, position INTEGER NOT NULL, path TEXT NOT NULL,
  PRIMARY KEY(request_id, position)) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS account(
  msisdn TEXT PRIMARY KEY, access_key TEXT NOT NULL DEFAULT '',
  push_cursor INTEGER NOT NULL DEFAULT 0) WITHOUT ROWID;
)";

// Held while a damaged file is looked at and moved, so that of two processes that find it damaged
// the second does not move away the new one.
class MoveLock {
 public:
  explicit MoveLock(const std::string& path)
      : _fd(::open((path + ".lock").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, kPrivateFile)) {
    if (_fd >= 0) flock(_fd, LOCK_EX);
  }
  ~MoveLock() {
    if (_fd >= 0) close(_fd);
  }
  MoveLock(const MoveLock&) = delete;
  MoveLock& operator=(const MoveLock&) = delete;

 private:
  int _fd;
};

}  // namespace

StoreFile::StoreFile(std::string path) : _path(std::move(path)) {}

StoreFile::~StoreFile() = default;

store::Database* StoreFile::database() {
  if (_database && isReplaced()) _database.reset();
  if (!_database) open();
  if (!_database) {
    examine();
    open();
  }
  return _database.get();
}

void StoreFile::open() {
  const base::OwnedText folder(g_path_get_dirname(_path.c_str()));
  g_mkdir_with_parents(folder.get(), kPrivate);
  // The account's key lies in it; SQLite gives its other files the mode of this one.
  const int fd = ::open(_path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, kPrivateFile);
  if (fd >= 0) close(fd);
  _database = store::Database::open(_path, kSchema);
  struct stat status;
  if (!_database || stat(_path.c_str(), &status) != 0) return;
  _device = status.st_dev;
  _inode = status.st_ino;
}

bool StoreFile::isReplaced() const {
  struct stat status;
  return stat(_path.c_str(), &status) != 0 || status.st_dev != _device || status.st_ino != _inode;
}

void StoreFile::examine() {
  const MoveLock lock(_path);
  if (!isDamaged()) return;
  _database.reset();
  moveAside();
}

// A fresh connection: what an open one says depends on what it has read before.
bool StoreFile::isDamaged() const {
  sqlite3* handle = nullptr;
  int result = sqlite3_open_v2(_path.c_str(), &handle, SQLITE_OPEN_READWRITE, nullptr);
  const base::Owned<sqlite3, sqlite3_close> owner(handle);
  if (result != SQLITE_OK) return false;
  sqlite3_stmt* prepared = nullptr;
  result = sqlite3_prepare_v2(handle, "PRAGMA quick_check(1)", -1, &prepared, nullptr);
  const base::Owned<sqlite3_stmt, sqlite3_finalize> check(prepared);
  if (result == SQLITE_OK) result = sqlite3_step(prepared);
  if (result == SQLITE_ROW) {
    const auto* verdict = reinterpret_cast<const char*>(sqlite3_column_text(prepared, 0));
    return g_strcmp0(verdict, "ok") != 0;
  }
  return result == SQLITE_NOTADB || result == SQLITE_CORRUPT;
}

void StoreFile::moveAside() {
  const std::string aside = _path + ".damaged-" + std::to_string(g_get_real_time() / 1000);
  g_warning("zelqo: the store is damaged and was moved to %s", aside.c_str());
  for (const char* part : {"", "-wal", "-shm"}) {
    if (rename((_path + part).c_str(), (aside + part).c_str()) != 0 && errno != ENOENT) {
      g_warning("zelqo: cannot move %s%s: %s", _path.c_str(), part, g_strerror(errno));
    }
  }
}

}  // namespace zelqo
