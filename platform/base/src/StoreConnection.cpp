#include "StoreConnection.h"

#include <common/Database.h>

namespace base {
namespace {

/// A statement is reset after every use: a stepped one holds its read lock.
class Use {
 public:
  explicit Use(sqlite3_stmt* statement) : _statement(statement) {}
  ~Use() {
    sqlite3_reset(_statement);
    sqlite3_clear_bindings(_statement);
  }
  Use(const Use&) = delete;
  Use& operator=(const Use&) = delete;

  void bind(int column, const std::string& text) {
    sqlite3_bind_text(_statement, column, text.data(), static_cast<int>(text.size()),
                      SQLITE_STATIC);
  }
  void bind(int column, int64_t number) { sqlite3_bind_int64(_statement, column, number); }
  int step() { return sqlite3_step(_statement); }

 private:
  sqlite3_stmt* _statement;
};

std::string columnText(sqlite3_stmt* statement, int column) {
  const auto* text = reinterpret_cast<const char*>(sqlite3_column_text(statement, column));
  return text ? std::string(text, sqlite3_column_bytes(statement, column)) : std::string();
}

}  // namespace

int StoreConnection::open(const std::string& path, bool create) {
  if (create) common::makePrivateFile(path);
  sqlite3* db = nullptr;
  const int flags = SQLITE_OPEN_READWRITE | (create ? SQLITE_OPEN_CREATE : 0);
  int code = common::openSharedFile(path, flags, &db);
  _db.reset(db);
  if (code != SQLITE_OK) return code;
  if ((code = common::switchToWal(_db.get())) != SQLITE_OK) return code;
  if ((code = execute("PRAGMA synchronous=NORMAL")) != SQLITE_OK) return code;
  code = execute("CREATE TABLE IF NOT EXISTS pref(k TEXT PRIMARY KEY, v) WITHOUT ROWID");
  return code == SQLITE_OK ? prepareAll() : code;
}

int StoreConnection::execute(const char* sql) {
  return sqlite3_exec(_db.get(), sql, nullptr, nullptr, nullptr);
}

int StoreConnection::prepare(const char* sql, Statement& statement) {
  sqlite3_stmt* prepared = nullptr;
  const int code =
      sqlite3_prepare_v3(_db.get(), sql, -1, SQLITE_PREPARE_PERSISTENT, &prepared, nullptr);
  statement.reset(prepared);
  return code;
}

int StoreConnection::prepareAll() {
  const std::pair<const char*, Statement&> statements[] = {
      {"SELECT v FROM pref WHERE k=?", _get},
      {"INSERT INTO pref(k,v) VALUES(?,?) ON CONFLICT(k) DO UPDATE SET v=excluded.v", _set},
      {"DELETE FROM pref WHERE k=? RETURNING 1", _remove},
      {"DELETE FROM pref", _removeAll},
      {"SELECT k FROM pref ORDER BY k", _keys},
  };
  for (const auto& [sql, statement] : statements) {
    const int code = prepare(sql, statement);
    if (code != SQLITE_OK) return code;
  }
  return SQLITE_OK;
}

void StoreConnection::beginReading() {
  execute("BEGIN");
}

void StoreConnection::endReading() {
  if (!sqlite3_get_autocommit(_db.get())) execute("COMMIT");
}

int StoreConnection::get(const std::string& key, KeyValueStore::Value& value) {
  Use use(_get.get());
  use.bind(1, key);
  const int code = use.step();
  if (code != SQLITE_ROW) return code;
  if (sqlite3_column_type(_get.get(), 0) == SQLITE_INTEGER) {
    value = static_cast<int64_t>(sqlite3_column_int64(_get.get(), 0));
  } else {
    value = columnText(_get.get(), 0);
  }
  return code;
}

int StoreConnection::set(const std::string& key, const KeyValueStore::Value& value) {
  Use use(_set.get());
  use.bind(1, key);
  std::visit([&use](const auto& plain) { use.bind(2, plain); }, value);
  return use.step();
}

int StoreConnection::remove(const std::string& key) {
  Use use(_remove.get());
  use.bind(1, key);
  const int code = use.step();
  // The row is the RETURNING clause's; the statement commits with its last step.
  return code == SQLITE_ROW && use.step() != SQLITE_DONE ? SQLITE_ERROR : code;
}

int StoreConnection::removeAll() {
  return Use(_removeAll.get()).step();
}

int StoreConnection::keys(std::vector<std::string>& keys) {
  Use use(_keys.get());
  keys.clear();
  int code = SQLITE_ROW;
  while ((code = use.step()) == SQLITE_ROW) keys.push_back(columnText(_keys.get(), 0));
  return code;
}

}  // namespace base
