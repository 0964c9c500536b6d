#include <common/Database.h>
#include <fcntl.h>
#include <unistd.h>

#include <atomic>
#include <mutex>

namespace common {
namespace {

/// A write takes a millisecond or two. Who keeps a file for longer hangs, and its neighbours must
/// not: a person takes an application that does not answer for a second for dead.
constexpr gint64 kPatienceUs = 500000;
/// So long after a wait in vain nobody in this process waits again.
constexpr gint64 kImpatientUs = 2000000;
constexpr gulong kPauseUs = 2000;

/// When this process last waited in vain, and since when each thread waits.
std::atomic<gint64> inVain{-kImpatientUs};
thread_local gint64 waitingSince = 0;

int busyCb(void*, int tries) {
  const gint64 now = g_get_monotonic_time();
  if (tries == 0) waitingSince = now;
  if (now - inVain < kImpatientUs) return 0;
  if (now - waitingSince >= kPatienceUs) {
    inVain = now;
    return 0;
  }
  g_usleep(kPauseUs);
  return 1;
}

constexpr int kWalTries = 100;
constexpr gulong kWalPauseUs = 5000;

void logFailure(sqlite3* handle, const char* what) {
  g_warning("database: %s: %s", what, handle ? sqlite3_errmsg(handle) : "out of memory");
}

/// SQLite would set aside 130 KB for each connection, for small files of some hundred rows.
void limitMemory() {
  sqlite3_config(SQLITE_CONFIG_PAGECACHE, nullptr, 0, 0);
  sqlite3_config(SQLITE_CONFIG_LOOKASIDE, 0, 0);
}

}  // namespace

int openSharedFile(const std::string& path, int flags, sqlite3** handle) {
  static std::once_flag first;
  std::call_once(first, limitMemory);
  const int result = sqlite3_open_v2(path.c_str(), handle, flags, nullptr);
  if (*handle) sqlite3_busy_handler(*handle, busyCb, nullptr);
  return result;
}

int switchToWal(sqlite3* handle) {
  int result = SQLITE_BUSY;
  for (int i = 0; i < kWalTries && result == SQLITE_BUSY; i++) {
    if (i > 0) g_usleep(kWalPauseUs);
    result = sqlite3_exec(handle, "PRAGMA journal_mode=WAL", nullptr, nullptr, nullptr);
  }
  return result;
}

void makePrivateFile(const std::string& path) {
  const int file = ::open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, S_IRUSR | S_IWUSR);
  if (file >= 0) close(file);
}

Statement::~Statement() {
  if (!_statement) return;
  sqlite3_reset(_statement);
  sqlite3_clear_bindings(_statement);
}

Statement& Statement::bind(const std::string& text) {
  if (_statement) {
    sqlite3_bind_text(_statement, _next++, text.data(), static_cast<int>(text.size()),
                      SQLITE_TRANSIENT);
  }
  return *this;
}

Statement& Statement::bind(std::int64_t number) {
  if (_statement) sqlite3_bind_int64(_statement, _next++, number);
  return *this;
}

Statement& Statement::bind(const std::optional<std::string>& text) {
  if (text) return bind(*text);
  _next++;
  return *this;
}

Statement& Statement::bind(const std::optional<std::int64_t>& number) {
  if (number) return bind(*number);
  _next++;
  return *this;
}

bool Statement::step() {
  const int result = _statement ? sqlite3_step(_statement) : SQLITE_MISUSE;
  _failed = result != SQLITE_ROW && result != SQLITE_DONE;
  if (_failed && _statement) logFailure(sqlite3_db_handle(_statement), "reading failed");
  return result == SQLITE_ROW;
}

bool Statement::run() {
  if (!_statement) return false;
  if (sqlite3_step(_statement) == SQLITE_DONE) return true;
  logFailure(sqlite3_db_handle(_statement), "writing failed");
  return false;
}

std::string Statement::text(int column) const {
  return optionalText(column).value_or(std::string());
}

std::int64_t Statement::number(int column) const {
  return sqlite3_column_int64(_statement, column);
}

std::optional<std::string> Statement::optionalText(int column) const {
  const auto* bytes = sqlite3_column_text(_statement, column);
  if (!bytes) return std::nullopt;
  return std::string(reinterpret_cast<const char*>(bytes),
                     static_cast<std::size_t>(sqlite3_column_bytes(_statement, column)));
}

std::optional<std::int64_t> Statement::optionalNumber(int column) const {
  if (sqlite3_column_type(_statement, column) == SQLITE_NULL) return std::nullopt;
  return number(column);
}

std::unique_ptr<Database> Database::open(const std::string& path, const char* schema) {
  makePrivateFile(path);
  sqlite3* handle = nullptr;
  const int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE;
  const bool opened = openSharedFile(path, flags, &handle) == SQLITE_OK;
  std::unique_ptr<Database> database(new Database(handle));
  if (opened && database->configure(schema)) return database;
  logFailure(handle, ("cannot open " + path).c_str());
  return nullptr;
}

bool Database::configure(const char* schema) {
  return switchToWal(_handle.get()) == SQLITE_OK && execute("PRAGMA synchronous=NORMAL") &&
         execute("PRAGMA foreign_keys=ON") && execute(schema);
}

Statement Database::prepare(const char* sql) {
  auto& statement = _statements[sql];
  if (!statement) {
    sqlite3_stmt* prepared = nullptr;
    if (sqlite3_prepare_v3(_handle.get(), sql, -1, SQLITE_PREPARE_PERSISTENT, &prepared, nullptr) !=
        SQLITE_OK) {
      logFailure(_handle.get(), sql);
    }
    statement.reset(prepared);
  }
  return Statement(statement.get());
}

bool Database::execute(const char* sql) {
  if (sqlite3_exec(_handle.get(), sql, nullptr, nullptr, nullptr) == SQLITE_OK) return true;
  logFailure(_handle.get(), sql);
  return false;
}

}  // namespace common
