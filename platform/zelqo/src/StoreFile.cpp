#include "StoreFile.h"

#include <common/DamagedDatabase.h>
#include <common/Owned.h>
#include <sys/stat.h>

namespace zelqo {
namespace {

constexpr mode_t kPrivate = 0700;

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

}  // namespace

StoreFile::StoreFile(std::string path) : _path(std::move(path)) {}

StoreFile::~StoreFile() = default;

common::Database* StoreFile::database() {
  if (_database && isReplaced()) _database.reset();
  if (!_database) open();
  if (!_database) {
    examine();
    open();
  }
  return _database.get();
}

void StoreFile::open() {
  const common::OwnedText folder(g_path_get_dirname(_path.c_str()));
  g_mkdir_with_parents(folder.get(), kPrivate);
  _database = common::Database::open(_path, kSchema);
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
  _database.reset();
  const std::string aside = _path + ".damaged-" + std::to_string(g_get_real_time() / 1000);
  if (common::examineDatabase(_path, aside) == common::Examined::SetAside) {
    g_warning("zelqo: the store is damaged and was moved to %s", aside.c_str());
  }
}

}  // namespace zelqo
