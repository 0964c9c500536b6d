#include "store.h"

#include <glib.h>

#include <utility>

namespace store {
namespace {

constexpr int kBusyTimeoutMs = 3000;
constexpr int kWalTries = 20;
constexpr gulong kWalPauseUs = 5000;

void logFailure(sqlite3* handle, const char* what) {
  g_warning("store: %s: %s", what, handle ? sqlite3_errmsg(handle) : "out of memory");
}

// Two processes that create the file together: the switch to WAL fails as "locked" at once and
// ignores the busy timeout.
bool switchToWal(sqlite3* handle) {
  for (int i = 0; i < kWalTries; i++) {
    const int result = sqlite3_exec(handle, "PRAGMA journal_mode=WAL", nullptr, nullptr, nullptr);
    if (result != SQLITE_BUSY) return result == SQLITE_OK;
    g_usleep(kWalPauseUs);
  }
  return false;
}

}  // namespace

void Statement::Finalize::operator()(sqlite3_stmt* statement) const {
  sqlite3_finalize(statement);
}

Statement& Statement::bind(const std::string& text) {
  sqlite3_bind_text(_statement.get(), _next++, text.data(), static_cast<int>(text.size()),
                    SQLITE_TRANSIENT);
  return *this;
}

Statement& Statement::bind(std::int64_t number) {
  sqlite3_bind_int64(_statement.get(), _next++, number);
  return *this;
}

Statement& Statement::bindNull() {
  sqlite3_bind_null(_statement.get(), _next++);
  return *this;
}

bool Statement::step() {
  const int result = _statement ? sqlite3_step(_statement.get()) : SQLITE_MISUSE;
  _failed = result != SQLITE_ROW && result != SQLITE_DONE;
  if (_failed && _statement) {
    logFailure(sqlite3_db_handle(_statement.get()), "reading failed");
  }
  return result == SQLITE_ROW;
}

bool Statement::run() {
  if (!_statement) return false;
  if (sqlite3_step(_statement.get()) == SQLITE_DONE) return true;
  logFailure(sqlite3_db_handle(_statement.get()), "writing failed");
  return false;
}

std::string Statement::text(int column) const {
  const auto* bytes = sqlite3_column_text(_statement.get(), column);
  if (!bytes) return {};
  return {reinterpret_cast<const char*>(bytes),
          static_cast<std::size_t>(sqlite3_column_bytes(_statement.get(), column))};
}

std::int64_t Statement::number(int column) const {
  return sqlite3_column_int64(_statement.get(), column);
}

bool Statement::isNull(int column) const {
  return sqlite3_column_type(_statement.get(), column) == SQLITE_NULL;
}

std::unique_ptr<Database> Database::open(const std::string& path, const char* schema) {
  sqlite3* handle = nullptr;
  const int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE;
  const bool opened = sqlite3_open_v2(path.c_str(), &handle, flags, nullptr) == SQLITE_OK;
  std::unique_ptr<Database> database(new Database(handle));
  if (opened && database->configure(schema)) return database;
  logFailure(handle, ("cannot open " + path).c_str());
  return nullptr;
}

Database::~Database() {
  sqlite3_close(_handle);
}

bool Database::configure(const char* schema) {
  sqlite3_busy_timeout(_handle, kBusyTimeoutMs);
  return switchToWal(_handle) && execute("PRAGMA synchronous=NORMAL") && execute(schema);
}

Statement Database::prepare(const char* sql) {
  sqlite3_stmt* statement = nullptr;
  if (sqlite3_prepare_v2(_handle, sql, -1, &statement, nullptr) != SQLITE_OK) {
    logFailure(_handle, sql);
  }
  return Statement(statement);
}

bool Database::execute(const char* sql) {
  if (sqlite3_exec(_handle, sql, nullptr, nullptr, nullptr) == SQLITE_OK) return true;
  logFailure(_handle, sql);
  return false;
}

std::int64_t Database::lastRowId() const {
  return sqlite3_last_insert_rowid(_handle);
}

int Database::changes() const {
  return sqlite3_changes(_handle);
}

}  // namespace store
