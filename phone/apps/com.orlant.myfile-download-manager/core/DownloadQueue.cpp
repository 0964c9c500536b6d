#include "DownloadQueue.h"

#include <filesystem>

#include <common/Database.h>

namespace downloads {
namespace {

constexpr const char* kSchema =
    "CREATE TABLE IF NOT EXISTS download(id INTEGER PRIMARY KEY AUTOINCREMENT, "
    "url TEXT NOT NULL, name TEXT NOT NULL, size INTEGER NOT NULL, token TEXT NOT NULL, "
    "sender TEXT NOT NULL, wifi_only INTEGER NOT NULL, state INTEGER NOT NULL, "
    "failure INTEGER NOT NULL, etag TEXT NOT NULL, path TEXT NOT NULL)";

std::unique_ptr<common::Database> open(const std::string& file) {
  std::error_code ignored;
  std::filesystem::create_directories(std::filesystem::path(file).parent_path(), ignored);
  return common::Database::open(file, kSchema);
}

Download read(const common::Statement& row) {
  Download download;
  download.id = row.number(0);
  download.url = row.text(1);
  download.name = row.text(2);
  download.size = static_cast<std::uint64_t>(row.number(3));
  download.token = row.text(4);
  download.sender = row.text(5);
  download.wifiOnly = row.number(6) != 0;
  download.state = static_cast<State>(row.number(7));
  download.failure = static_cast<Failure>(row.number(8));
  download.etag = row.text(9);
  download.path = row.text(10);
  if (download.state == State::Running) download.state = State::Queued;
  return download;
}

}  // namespace

DownloadQueue::DownloadQueue(const std::string& file) : _database(open(file)) {}

DownloadQueue::~DownloadQueue() = default;

std::vector<Download> DownloadQueue::load() {
  std::vector<Download> all;
  if (!_database) return all;
  auto rows = _database->prepare(
      "SELECT id, url, name, size, token, sender, wifi_only, state, failure, etag, path "
      "FROM download ORDER BY id");
  while (rows.step()) all.push_back(read(rows));
  return all;
}

bool DownloadQueue::save(Download& download) {
  if (!_database) return false;
  auto statement = _database->prepare(
      "INSERT OR REPLACE INTO download(id, url, name, size, token, sender, wifi_only, state, "
      "failure, etag, path) VALUES(?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?)");
  statement.bind(download.id != 0 ? std::optional(download.id) : std::nullopt)
      .bind(download.url)
      .bind(download.name)
      .bind(static_cast<std::int64_t>(download.size))
      .bind(download.token)
      .bind(download.sender)
      .bind(download.wifiOnly ? 1 : 0)
      .bind(static_cast<std::int64_t>(download.state))
      .bind(static_cast<std::int64_t>(download.failure))
      .bind(download.etag)
      .bind(download.path);
  if (!statement.run()) return false;
  if (download.id == 0) download.id = _database->lastRowId();
  return true;
}

bool DownloadQueue::remove(std::int64_t id) {
  return _database && _database->prepare("DELETE FROM download WHERE id = ?").bind(id).run();
}

}  // namespace downloads
