/// The phone's databases: SQLite files in WAL mode that several processes share.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace store {

/// One execution of a prepared statement: bind in order, then step or run.
class Statement {
 public:
  explicit Statement(sqlite3_stmt* statement) : _statement(statement) {}

  Statement& bind(const std::string& text);
  Statement& bind(std::int64_t number);
  Statement& bindNull();

  /// True while there is a row.
  bool step();
  /// Whether step() ended for another reason than having no more rows.
  bool failed() const { return _failed; }
  /// Runs a statement without rows; false when it failed.
  bool run();

  /// Columns of the current row; null gives an empty text.
  std::string text(int column) const;
  std::int64_t number(int column) const;
  bool isNull(int column) const;

 private:
  struct Finalize {
    void operator()(sqlite3_stmt* statement) const;
  };
  std::unique_ptr<sqlite3_stmt, Finalize> _statement;
  int _next = 1;
  bool _failed = false;
};

class Database {
 public:
  /// Opens or creates the file and runs `schema`, which must be harmless on an existing database.
  /// Null, with a line on the log, when that fails.
  static std::unique_ptr<Database> open(const std::string& path, const char* schema);
  ~Database();
  Database(const Database&) = delete;
  Database& operator=(const Database&) = delete;

  Statement prepare(const char* sql);
  bool execute(const char* sql);
  std::int64_t lastRowId() const;
  /// Rows that the last statement changed.
  int changes() const;

 private:
  explicit Database(sqlite3* handle) : _handle(handle) {}
  bool configure(const char* schema);
  sqlite3* _handle;
};

}  // namespace store
