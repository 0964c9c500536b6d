#include "Sqlite.h"

namespace service {
namespace {

constexpr int kBusyTimeoutMs = 3000;

}  // namespace

Query::~Query() {
  if (!_statement) return;
  sqlite3_reset(_statement);
  sqlite3_clear_bindings(_statement);
}

Query& Query::bind(const std::string& text) {
  if (_statement) {
    sqlite3_bind_text(_statement, _next++, text.data(), static_cast<int>(text.size()),
                      SQLITE_TRANSIENT);
  }
  return *this;
}

Query& Query::bind(std::int64_t number) {
  if (_statement) sqlite3_bind_int64(_statement, _next++, number);
  return *this;
}

Query& Query::bind(const std::optional<std::string>& text) {
  if (text) return bind(*text);
  _next++;
  return *this;
}

Query& Query::bind(const std::optional<std::int64_t>& number) {
  if (number) return bind(*number);
  _next++;
  return *this;
}

bool Query::step() {
  if (!_statement) return false;
  const int result = sqlite3_step(_statement);
  if (result != SQLITE_ROW && result != SQLITE_DONE) {
    g_warning("database: %s", sqlite3_errmsg(sqlite3_db_handle(_statement)));
  }
  return result == SQLITE_ROW;
}

bool Query::run() {
  if (!_statement) return false;
  if (sqlite3_step(_statement) == SQLITE_DONE) return true;
  g_warning("database: %s", sqlite3_errmsg(sqlite3_db_handle(_statement)));
  return false;
}

std::string Query::text(int column) const {
  return optionalText(column).value_or(std::string());
}

std::int64_t Query::number(int column) const {
  return sqlite3_column_int64(_statement, column);
}

std::optional<std::string> Query::optionalText(int column) const {
  const auto* bytes = sqlite3_column_text(_statement, column);
  if (!bytes) return std::nullopt;
  return std::string(reinterpret_cast<const char*>(bytes),
                     static_cast<std::size_t>(sqlite3_column_bytes(_statement, column)));
}

std::optional<std::int64_t> Query::optionalNumber(int column) const {
  if (sqlite3_column_type(_statement, column) == SQLITE_NULL) return std::nullopt;
  return number(column);
}

bool Sqlite::open(const std::string& path, const char* schema) {
  sqlite3* handle = nullptr;
  const int result = sqlite3_open(path.c_str(), &handle);
  _handle.reset(handle);
  if (result != SQLITE_OK) {
    g_warning("database: cannot open %s: %s", path.c_str(), sqlite3_errstr(result));
    return false;
  }
  sqlite3_busy_timeout(handle, kBusyTimeoutMs);
  return execute("PRAGMA journal_mode=WAL") && execute("PRAGMA synchronous=NORMAL") &&
         execute("PRAGMA foreign_keys=ON") && execute(schema);
}

bool Sqlite::execute(const char* sql) {
  if (sqlite3_exec(_handle.get(), sql, nullptr, nullptr, nullptr) == SQLITE_OK) return true;
  g_warning("database: %s", sqlite3_errmsg(_handle.get()));
  return false;
}

Query Sqlite::query(const char* sql) {
  auto& statement = _statements[sql];
  if (!statement) {
    sqlite3_stmt* prepared = nullptr;
    if (sqlite3_prepare_v3(_handle.get(), sql, -1, SQLITE_PREPARE_PERSISTENT, &prepared, nullptr) !=
        SQLITE_OK) {
      g_warning("database: %s", sqlite3_errmsg(_handle.get()));
    }
    statement.reset(prepared);
  }
  return Query(statement.get());
}

}  // namespace service
