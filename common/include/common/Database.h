/// SQLite files in WAL mode that several processes share.
#pragma once

#include <common/Owned.h>
#include <sqlite3.h>

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace common {

/// Makes an empty file that is its owner's alone, when there is none: SQLite keeps its mode, and
/// gives it to the files beside it.
void makePrivateFile(const std::string& path);

/// As sqlite3_open_v2(). Where another process is writing the file, the connection waits half a
/// second, and for a while not at all when that was in vain. It takes little memory.
int openSharedFile(const std::string& path, int flags, sqlite3** handle);

/// SQLite's result. Two processes that make the file together collide here at once, whatever their
/// patience: the switch is tried again for half a second.
int switchToWal(sqlite3* handle);

/// One execution of a prepared statement, reset when the use of it ends: bind in order, then step
/// or run.
class Statement {
 public:
  explicit Statement(sqlite3_stmt* statement) : _statement(statement) {}
  Statement(const Statement&) = delete;
  Statement& operator=(const Statement&) = delete;
  ~Statement();

  Statement& bind(const std::string& text);
  Statement& bind(std::int64_t number);
  /// Nothing is bound as null.
  Statement& bind(const std::optional<std::string>& text);
  Statement& bind(const std::optional<std::int64_t>& number);

  /// True while there is a row.
  bool step();
  /// Whether step() ended for another reason than having no more rows.
  bool failed() const { return _failed; }
  /// Runs a statement without rows; false when it failed.
  bool run();

  /// Columns of the current row; null gives an empty text, or 0.
  std::string text(int column) const;
  std::int64_t number(int column) const;
  std::optional<std::string> optionalText(int column) const;
  std::optional<std::int64_t> optionalNumber(int column) const;

 private:
  sqlite3_stmt* _statement;
  int _next = 1;
  bool _failed = false;
};

class Database {
 public:
  /// Opens or creates the file, for its owner only, and runs `schema`, which must be harmless on an
  /// existing database. Null, with a line on the log, when that fails.
  static std::unique_ptr<Database> open(const std::string& path, const char* schema);
  Database(const Database&) = delete;
  Database& operator=(const Database&) = delete;

  /// Prepared at its first use and kept. `sql` outlives the database and is in use by at most one
  /// Statement at a time.
  Statement prepare(const char* sql);
  bool execute(const char* sql);
  std::int64_t lastRowId() const { return sqlite3_last_insert_rowid(_handle.get()); }
  /// Rows that the last statement changed.
  int changes() const { return sqlite3_changes(_handle.get()); }

 private:
  explicit Database(sqlite3* handle) : _handle(handle) {}
  bool configure(const char* schema);

  Owned<sqlite3, sqlite3_close_v2> _handle;
  std::unordered_map<std::string_view, Owned<sqlite3_stmt, sqlite3_finalize>> _statements;
};

/// Rolled back unless committed.
class Transaction {
 public:
  explicit Transaction(Database& database)
      : _database(database), _open(database.execute("BEGIN IMMEDIATE")) {}
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
  Database& _database;
  bool _open;
};

}  // namespace common
