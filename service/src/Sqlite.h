/// SQLite in the few ways in which the service uses it.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

#include "Owned.h"

namespace service {

/// A prepared statement, reset when the use of it ends.
class Query {
 public:
  explicit Query(sqlite3_stmt* statement) : _statement(statement) {}
  Query(const Query&) = delete;
  Query& operator=(const Query&) = delete;
  ~Query();

  Query& bind(const std::string& text);
  Query& bind(std::int64_t number);
  Query& bind(const std::optional<std::string>& text);
  Query& bind(const std::optional<std::int64_t>& number);

  /// True while there is a row.
  bool step();
  /// Runs a statement without rows; false when it failed.
  bool run();

  std::string text(int column) const;
  std::int64_t number(int column) const;
  std::optional<std::string> optionalText(int column) const;
  std::optional<std::int64_t> optionalNumber(int column) const;

 private:
  sqlite3_stmt* _statement;
  int _next = 1;
};

class Sqlite {
 public:
  /// Opens or creates the file; false, with a log line, when that fails.
  bool open(const std::string& path, const char* schema);
  bool execute(const char* sql);
  /// Prepared at its first use and kept; a text is in use by at most one Query at a time.
  Query query(const char* sql);
  std::int64_t lastRowId() const { return sqlite3_last_insert_rowid(_handle.get()); }
  int changes() const { return sqlite3_changes(_handle.get()); }

 private:
  Owned<sqlite3, sqlite3_close_v2> _handle;
  std::unordered_map<std::string_view, Owned<sqlite3_stmt, sqlite3_finalize>> _statements;
};

/// Rolled back unless committed.
class Transaction {
 public:
  explicit Transaction(Sqlite& database) : _database(database) {
    _open = _database.execute("BEGIN IMMEDIATE");
  }
  Transaction(const Transaction&) = delete;
  Transaction& operator=(const Transaction&) = delete;
  ~Transaction() {
    if (_open) _database.execute("ROLLBACK");
  }
  bool commit() {
    _open = !_database.execute("COMMIT");
    return !_open;
  }

 private:
  Sqlite& _database;
  bool _open;
};

}  // namespace service
