#include "zelqo/Store.h"

#include <base/PhonePaths.h>

#include <algorithm>

#include "StoreFile.h"

namespace zelqo {
namespace {

using common::Database;
using common::Statement;

bool runWith(Database& database, const char* sql, const std::string& text) {
  return database.prepare(sql).bind(text).run();
}

bool runWith(Database& database, const char* sql, std::int64_t number) {
  return database.prepare(sql).bind(number).run();
}

bool insertFiles(Database& database, const ReceivedShare& share) {
  std::int64_t position = 0;
  for (const ReceivedFile& file : share.files) {
    Statement insert = database.prepare(
        "INSERT INTO received_file(token, position, name, size, type, url, thumb, mid, big) "
        "VALUES(?, ?, ?, ?, ?, ?, ?, ?, ?)");
    insert.bind(share.token).bind(position++);
    insert.bind(file.name);
    insert.bind(file.size);
    for (const auto* text : {&file.type, &file.url, &file.thumb, &file.mid, &file.big}) {
      insert.bind(*text);
    }
    if (!insert.run()) return false;
  }
  return true;
}

bool insertTexts(Database& database, const char* sql, std::int64_t requestId,
                 const std::vector<std::string>& texts) {
  std::int64_t position = 0;
  for (const std::string& text : texts) {
    if (!database.prepare(sql).bind(requestId).bind(position++).bind(text).run()) return false;
  }
  return true;
}

bool readTexts(Database& database, const char* sql, std::int64_t requestId,
               std::vector<std::string>& texts) {
  Statement rows = database.prepare(sql);
  rows.bind(requestId);
  while (rows.step()) texts.push_back(rows.text(0));
  return !rows.failed();
}

constexpr char kRecipients[] =
    "SELECT msisdn FROM sent_recipient WHERE request_id = ? ORDER BY position";
constexpr char kPaths[] = "SELECT path FROM sent_file WHERE request_id = ? ORDER BY position";

/// What all shares have, in columns 2 to 5.
template <typename Share>
void readState(Statement& row, Share& share) {
  share.single = row.number(2) != 0;
  share.createdMs = row.number(3);
  share.expiresMs = row.number(4);
  share.recalledMs = row.optionalNumber(5);
}

bool readReceived(Database& database, const std::string& token,
                  std::optional<ReceivedShare>& share) {
  Statement row = database.prepare(
      "SELECT sender, base, single, created_ms, expires_ms, recalled_ms FROM received "
      "WHERE token = ?");
  if (row.bind(token).step()) {
    share.emplace();
    share->token = token;
    share->sender = row.text(0);
    share->base = row.text(1);
    readState(row, *share);
  }
  return !row.failed();
}

bool readFiles(Database& database, const std::string& token, std::vector<ReceivedFile>& files) {
  Statement count = database.prepare("SELECT count(*) FROM received_file WHERE token = ?");
  if (count.bind(token).step()) files.reserve(static_cast<std::size_t>(count.number(0)));
  Statement rows = database.prepare(
      "SELECT name, size, type, url, thumb, mid, big FROM received_file WHERE token = ? "
      "ORDER BY position");
  rows.bind(token);
  while (rows.step()) {
    files.push_back({rows.optionalText(0), rows.optionalNumber(1), rows.optionalText(2),
                     rows.optionalText(3), rows.optionalText(4), rows.optionalText(5),
                     rows.optionalText(6)});
  }
  return !rows.failed();
}

bool readSent(Database& database, std::int64_t requestId, std::optional<SentShare>& share) {
  Statement row = database.prepare(
      "SELECT token, sender, single, created_ms, expires_ms, recalled_ms FROM sent "
      "WHERE request_id = ?");
  if (row.bind(requestId).step()) {
    share.emplace();
    share->requestId = requestId;
    share->token = row.text(0);
    share->sender = row.text(1);
    readState(row, *share);
  }
  return !row.failed();
}

bool listReceived(Database& database, std::vector<ShareSummary>& list) {
  Statement rows = database.prepare(
      "SELECT token, sender, single, created_ms, expires_ms, recalled_ms, "
      "(SELECT count(*) FROM received_file WHERE received_file.token = received.token), "
      "(SELECT name FROM received_file WHERE received_file.token = received.token AND "
      "position = 0) FROM received");
  while (rows.step()) {
    ShareSummary& summary = list.emplace_back();
    summary.received = true;
    summary.token = rows.text(0);
    summary.numbers = {rows.text(1)};
    readState(rows, summary);
    summary.fileCount = rows.number(6);
    summary.firstFile = rows.text(7);
  }
  return !rows.failed();
}

bool listSent(Database& database, std::vector<ShareSummary>& list) {
  Statement rows = database.prepare(
      "SELECT token, request_id, single, created_ms, expires_ms, recalled_ms, "
      "(SELECT count(*) FROM sent_file WHERE sent_file.request_id = sent.request_id), "
      "(SELECT path FROM sent_file WHERE sent_file.request_id = sent.request_id AND position = 0) "
      "FROM sent");
  bool done = true;
  while (done && rows.step()) {
    ShareSummary& summary = list.emplace_back();
    summary.token = rows.text(0);
    summary.requestId = rows.number(1);
    readState(rows, summary);
    summary.fileCount = rows.number(6);
    summary.firstFile = rows.text(7);
    done = readTexts(database, kRecipients, summary.requestId, summary.numbers);
  }
  return done && !rows.failed();
}

}  // namespace

Store::Store() : Store(base::databaseFolder() + "/zelqo.db") {}

Store::Store(const std::string& path) : _file(std::make_unique<StoreFile>(path)) {}

Store::~Store() = default;

bool Store::usable() {
  return _file->database() != nullptr;
}

// One transaction, so that what is read belongs together and what is written is there as a whole. A
// damaged database is replaced, and the work done once more on the new one.
template <typename Work>
bool Store::run(const char* begin, Work work) {
  for (int attempt = 0; attempt < 2; attempt++) {
    Database* database = _file->database();
    if (!database) return false;
    if (database->execute(begin)) {
      if (work(*database) && database->execute("COMMIT")) return true;
      database->execute("ROLLBACK");
    }
    _file->examine();
  }
  return false;
}

template <typename Work>
bool Store::write(Work work) {
  return run("BEGIN IMMEDIATE", work);
}

template <typename Work>
bool Store::read(Work work) {
  return run("BEGIN", work);
}

bool Store::addReceived(const ReceivedShare& share) {
  return write([&share](Database& database) {
    if (!runWith(database, "DELETE FROM received_file WHERE token = ?", share.token)) return false;
    Statement insert = database.prepare(
        "INSERT INTO received(token, sender, base, single, created_ms, expires_ms, recalled_ms) "
        "VALUES(?, ?, ?, ?, ?, ?, ?) ON CONFLICT(token) DO UPDATE SET sender = excluded.sender, "
        "base = excluded.base, single = excluded.single, created_ms = excluded.created_ms, "
        "expires_ms = excluded.expires_ms, "
        "recalled_ms = coalesce(recalled_ms, excluded.recalled_ms)");
    insert.bind(share.token)
        .bind(share.sender)
        .bind(share.base)
        .bind(std::int64_t{share.single})
        .bind(share.createdMs)
        .bind(share.expiresMs);
    insert.bind(share.recalledMs);
    return insert.run() && insertFiles(database, share);
  });
}

bool Store::addSent(const SentShare& share) {
  return write([&share](Database& database) {
    const std::int64_t id = share.requestId;
    Statement insert = database.prepare(
        "INSERT OR REPLACE INTO sent(request_id, token, sender, single, created_ms, expires_ms, "
        "recalled_ms) VALUES(?, ?, ?, ?, ?, ?, ?)");
    insert.bind(id)
        .bind(share.token)
        .bind(share.sender)
        .bind(std::int64_t{share.single})
        .bind(share.createdMs)
        .bind(share.expiresMs);
    insert.bind(share.recalledMs);
    return insert.run() &&
           runWith(database, "DELETE FROM sent_recipient WHERE request_id = ?", id) &&
           runWith(database, "DELETE FROM sent_file WHERE request_id = ?", id) &&
           insertTexts(database, "INSERT INTO sent_recipient VALUES(?, ?, ?)", id,
                       share.recipients) &&
           insertTexts(database, "INSERT INTO sent_file VALUES(?, ?, ?)", id, share.paths);
  });
}

bool Store::markRecalled(const std::string& token, std::int64_t whenMs) {
  return write([&](Database& database) {
    return database
               .prepare(
                   "UPDATE received SET recalled_ms = ? WHERE token = ? AND recalled_ms IS "
                   "NULL")
               .bind(whenMs)
               .bind(token)
               .run() &&
           database
               .prepare("UPDATE sent SET recalled_ms = ? WHERE token = ? AND recalled_ms IS NULL")
               .bind(whenMs)
               .bind(token)
               .run();
  });
}

bool Store::removeReceived(const std::string& token) {
  return write([&token](Database& database) {
    return runWith(database, "DELETE FROM received WHERE token = ?", token) &&
           runWith(database, "DELETE FROM received_file WHERE token = ?", token);
  });
}

bool Store::removeSent(std::int64_t requestId) {
  return write([requestId](Database& database) {
    return runWith(database, "DELETE FROM sent WHERE request_id = ?", requestId) &&
           runWith(database, "DELETE FROM sent_recipient WHERE request_id = ?", requestId) &&
           runWith(database, "DELETE FROM sent_file WHERE request_id = ?", requestId);
  });
}

std::optional<ReceivedShare> Store::received(const std::string& token) {
  std::optional<ReceivedShare> share;
  const bool done = read([&](Database& database) {
    share.reset();
    return readReceived(database, token, share) &&
           (!share || readFiles(database, token, share->files));
  });
  if (!done) share.reset();
  return share;
}

std::optional<SentShare> Store::sent(std::int64_t requestId) {
  std::optional<SentShare> share;
  const bool done = read([&](Database& database) {
    share.reset();
    return readSent(database, requestId, share) &&
           (!share || (readTexts(database, kRecipients, requestId, share->recipients) &&
                       readTexts(database, kPaths, requestId, share->paths)));
  });
  if (!done) share.reset();
  return share;
}

std::vector<ShareSummary> Store::list() {
  std::vector<ShareSummary> list;
  const bool done = read([&list](Database& database) {
    list.clear();
    return listReceived(database, list) && listSent(database, list);
  });
  if (!done) list.clear();
  std::stable_sort(list.begin(), list.end(), [](const ShareSummary& a, const ShareSummary& b) {
    return a.createdMs > b.createdMs;
  });
  return list;
}

std::string Store::accessKey(const std::string& msisdn) {
  std::string key;
  read([&](Database& database) {
    Statement row = database.prepare("SELECT access_key FROM account WHERE msisdn = ?");
    if (row.bind(msisdn).step()) key = row.text(0);
    return !row.failed();
  });
  return key;
}

std::int64_t Store::pushCursor(const std::string& msisdn) {
  std::int64_t cursor = 0;
  read([&](Database& database) {
    Statement row = database.prepare("SELECT push_cursor FROM account WHERE msisdn = ?");
    if (row.bind(msisdn).step()) cursor = row.number(0);
    return !row.failed();
  });
  return cursor;
}

bool Store::setAccessKey(const std::string& msisdn, const std::string& key) {
  return write([&](Database& database) {
    return database
        .prepare(
            "INSERT INTO account(msisdn, access_key) VALUES(?, ?) "
            "ON CONFLICT(msisdn) DO UPDATE SET access_key = excluded.access_key")
        .bind(msisdn)
        .bind(key)
        .run();
  });
}

bool Store::setPushCursor(const std::string& msisdn, std::int64_t cursor) {
  return write([&](Database& database) {
    return database
        .prepare(
            "INSERT INTO account(msisdn, push_cursor) VALUES(?, ?) "
            "ON CONFLICT(msisdn) DO UPDATE SET push_cursor = excluded.push_cursor")
        .bind(msisdn)
        .bind(cursor)
        .run();
  });
}

}  // namespace zelqo
