#include <base/KeyValueStore.h>

#include "StoreConnection.h"

#include <dlog.h>
#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <cstdio>

namespace base {
namespace {

constexpr const char* kTag = "PLATFORM";

bool damaged(int code) {
  return code == SQLITE_CORRUPT || code == SQLITE_NOTADB;
}

std::string folderOf(const std::string& path) {
  OwnedText folder(g_path_get_dirname(path.c_str()));
  return folder.get();
}

int checkFile(const std::string& path) {
  StoreConnection connection;
  const int code = connection.open(path, false);
  return code == SQLITE_OK ? connection.check() : code;
}

/// Holds other processes back while a damaged store is moved aside. Locks the folder, so that no
/// lock file stays behind.
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

}  // namespace

KeyValueStore::KeyValueStore(std::string path) : _path(std::move(path)) {}

KeyValueStore::~KeyValueStore() = default;

int KeyValueStore::connect(bool create) {
  if (_connection) return SQLITE_OK;
  if (create) g_mkdir_with_parents(folderOf(_path).c_str(), 0755);
  auto connection = std::make_unique<StoreConnection>();
  const int code = connection->open(_path, create);
  if (code == SQLITE_OK) _connection = std::move(connection);
  return code;
}

/// Looks again under the lock: another process may have put a sound file there meanwhile.
int KeyValueStore::moveAsideIfDamaged() {
  _connection.reset();
  FolderLock lock(folderOf(_path));
  const int code = checkFile(_path);
  if (!damaged(code)) return code;
  dlog_print(DLOG_ERROR, kTag, "%s is damaged; it becomes .corrupt and a new one is begun",
             _path.c_str());
  for (const char* part : {"", "-wal", "-shm"}) {
    if (rename((_path + part).c_str(), (_path + ".corrupt" + part).c_str()) != 0 && !*part) {
      return SQLITE_CANTOPEN;
    }
  }
  return SQLITE_OK;
}

template <typename Operation>
KeyValueStore::Answer KeyValueStore::run(bool create, Operation operation) {
  if (!create && !_connection && access(_path.c_str(), F_OK) != 0) return Answer::NoKey;
  auto attempt = [&] {
    const int code = connect(create);
    return code == SQLITE_OK ? operation(*_connection) : code;
  };
  int code = attempt();
  if (damaged(code)) {
    code = moveAsideIfDamaged();
    create = true;
    if (code == SQLITE_OK) code = attempt();
  }
  if (code == SQLITE_ROW || code == SQLITE_OK) return Answer::Done;
  if (code == SQLITE_DONE) return Answer::NoKey;
  dlog_print(DLOG_ERROR, kTag, "%s: %s", _path.c_str(), sqlite3_errstr(code));
  return Answer::Failed;
}

KeyValueStore::Answer KeyValueStore::get(const std::string& key, Value& value) {
  return run(false, [&](StoreConnection& store) { return store.get(key, value); });
}

KeyValueStore::Answer KeyValueStore::set(const std::string& key, const Value& value) {
  const Answer answer = run(true, [&](StoreConnection& store) { return store.set(key, value); });
  return answer == Answer::NoKey ? Answer::Done : answer;
}

KeyValueStore::Answer KeyValueStore::remove(const std::string& key) {
  return run(false, [&](StoreConnection& store) { return store.remove(key); });
}

KeyValueStore::Answer KeyValueStore::removeAll() {
  const Answer answer = run(false, [](StoreConnection& store) { return store.removeAll(); });
  return answer == Answer::NoKey ? Answer::Done : answer;
}

KeyValueStore::Answer KeyValueStore::keys(std::vector<std::string>& keys) {
  keys.clear();
  const Answer answer = run(false, [&](StoreConnection& store) { return store.keys(keys); });
  return answer == Answer::NoKey ? Answer::Done : answer;
}

}  // namespace base
