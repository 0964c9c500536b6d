/// One open store file and its prepared statements. Every call answers an SQLite result code.
#pragma once

#include <base/KeyValueStore.h>
#include <common/Owned.h>
#include <sqlite3.h>

#include <string>
#include <vector>

namespace base {

class StoreConnection {
 public:
  StoreConnection() = default;
  StoreConnection(const StoreConnection&) = delete;
  StoreConnection& operator=(const StoreConnection&) = delete;

  int open(const std::string& path, bool create);

  /// Until endReading(), every get() answers from what the file held at the first of them.
  void beginReading();
  /// Does nothing when nothing was begun.
  void endReading();

  /// SQLITE_ROW when there is such a key, else SQLITE_DONE.
  int get(const std::string& key, KeyValueStore::Value& value);
  int set(const std::string& key, const KeyValueStore::Value& value);
  /// SQLITE_ROW when there was such a key, else SQLITE_DONE.
  int remove(const std::string& key);
  int removeAll();
  int keys(std::vector<std::string>& keys);

 private:
  using Statement = common::Owned<sqlite3_stmt, sqlite3_finalize>;

  int execute(const char* sql);
  int prepare(const char* sql, Statement& statement);
  int prepareAll();

  common::Owned<sqlite3, sqlite3_close>
      _db;  ///< declared first: closed after its statements are gone
  Statement _get, _set, _remove, _removeAll, _keys;
};

}  // namespace base
