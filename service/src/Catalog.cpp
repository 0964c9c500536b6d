#include "Catalog.h"

#include "Secrets.h"

namespace service {
namespace {

constexpr std::size_t kTokenBytes = 20;
constexpr std::size_t kKeyBytes = 32;

constexpr char kSchema[] = R"(
CREATE TABLE IF NOT EXISTS subscriber(
  msisdn TEXT PRIMARY KEY, imsi TEXT NOT NULL, sharing INTEGER NOT NULL) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS access(
  fingerprint TEXT PRIMARY KEY,
  msisdn TEXT NOT NULL REFERENCES subscriber ON DELETE CASCADE) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS share(
  id INTEGER PRIMARY KEY AUTOINCREMENT, token TEXT NOT NULL UNIQUE, sender TEXT NOT NULL,
  state INTEGER NOT NULL, single INTEGER NOT NULL, lenient INTEGER NOT NULL,
  lifetime_s INTEGER NOT NULL, created_ms INTEGER NOT NULL, expires_ms INTEGER NOT NULL,
  file_count INTEGER NOT NULL, manifest TEXT NOT NULL DEFAULT '');
CREATE INDEX IF NOT EXISTS share_by_expiry ON share(state, expires_ms);
CREATE TABLE IF NOT EXISTS file(
  share INTEGER NOT NULL REFERENCES share ON DELETE CASCADE, position INTEGER NOT NULL,
  name TEXT, size INTEGER, type TEXT, url TEXT, thumb TEXT, mid TEXT, big TEXT,
  PRIMARY KEY(share, position)) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS recipient(
  share INTEGER NOT NULL REFERENCES share ON DELETE CASCADE, position INTEGER NOT NULL,
  msisdn TEXT NOT NULL, PRIMARY KEY(share, position)) WITHOUT ROWID;
CREATE TABLE IF NOT EXISTS event(
  id INTEGER PRIMARY KEY AUTOINCREMENT, msisdn TEXT NOT NULL, kind TEXT NOT NULL,
  share INTEGER NOT NULL REFERENCES share ON DELETE CASCADE);
CREATE INDEX IF NOT EXISTS event_by_msisdn ON event(msisdn, id);
CREATE INDEX IF NOT EXISTS event_by_share ON event(share);
)";

#define SHARE_COLUMNS \
  "id, token, sender, state, single, lenient, lifetime_s, created_ms, expires_ms, file_count"
#define FILE_COLUMNS "name, size, type, url, thumb, mid, big"

Share readShare(const common::Statement& row) {
  Share share;
  share.id = row.number(0);
  share.token = row.text(1);
  share.sender = row.text(2);
  share.state = static_cast<ShareState>(row.number(3));
  share.single = row.number(4) != 0;
  share.lenient = row.number(5) != 0;
  share.lifetimeS = row.number(6);
  share.createdMs = row.number(7);
  share.expiresMs = row.number(8);
  share.fileCount = row.number(9);
  return share;
}

std::vector<Share> readShares(common::Statement& query) {
  std::vector<Share> shares;
  while (query.step()) shares.push_back(readShare(query));
  return shares;
}

std::optional<Share> readOne(common::Statement& query) {
  if (!query.step()) return std::nullopt;
  return readShare(query);
}

ShareFile readFile(const common::Statement& row) {
  return {row.optionalText(0), row.optionalNumber(1), row.optionalText(2), row.optionalText(3),
          row.optionalText(4), row.optionalText(5),   row.optionalText(6)};
}

}  // namespace

bool Catalog::open(const std::string& path) {
  _database = common::Database::open(path, kSchema);
  return _database != nullptr;
}

std::string Catalog::signUp(const std::string& msisdn, const std::string& imsi) {
  const std::string key = randomHex(kKeyBytes);
  if (key.empty()) return {};
  common::Transaction transaction(*_database);
  const bool done = _database
                        ->prepare(
                            "INSERT INTO subscriber(msisdn, imsi, sharing) VALUES(?, ?, 1) "
                            "ON CONFLICT(msisdn) DO UPDATE SET imsi = excluded.imsi")
                        .bind(msisdn)
                        .bind(imsi)
                        .run() &&
                    _database->prepare("INSERT INTO access(fingerprint, msisdn) VALUES(?, ?)")
                        .bind(fingerprint(key))
                        .bind(msisdn)
                        .run();
  return done && transaction.commit() ? key : std::string();
}

std::optional<std::string> Catalog::ownerOf(const std::string& key) {
  common::Statement query = _database->prepare("SELECT msisdn FROM access WHERE fingerprint = ?");
  if (!query.bind(fingerprint(key)).step()) return std::nullopt;
  return query.text(0);
}

std::optional<bool> Catalog::sharingOn(const std::string& msisdn) {
  common::Statement query = _database->prepare("SELECT sharing FROM subscriber WHERE msisdn = ?");
  if (!query.bind(msisdn).step()) return std::nullopt;
  return query.number(0) != 0;
}

bool Catalog::setSharing(const std::string& msisdn, bool on) {
  return _database->prepare("UPDATE subscriber SET sharing = ? WHERE msisdn = ?")
      .bind(std::int64_t{on})
      .bind(msisdn)
      .run();
}

std::optional<Share> Catalog::create(const ShareDraft& draft, std::int64_t nowMs) {
  const std::string token = randomHex(kTokenBytes);
  if (token.empty()) return std::nullopt;
  common::Transaction transaction(*_database);
  if (!_database
           ->prepare("INSERT INTO share(token, sender, state, single, lenient, lifetime_s, "
                     "created_ms, expires_ms, file_count) VALUES(?, ?, 0, ?, ?, ?, ?, 0, ?)")
           .bind(token)
           .bind(draft.sender)
           .bind(std::int64_t{draft.single})
           .bind(std::int64_t{draft.lenient})
           .bind(draft.lifetimeS)
           .bind(nowMs)
           .bind(static_cast<std::int64_t>(draft.files.size()))
           .run()) {
    return std::nullopt;
  }
  const std::int64_t id = _database->lastRowId();
  if (!insertDetails(id, draft) || !transaction.commit()) return std::nullopt;
  return share(id);
}

bool Catalog::insertDetails(std::int64_t id, const ShareDraft& draft) {
  std::int64_t position = 0;
  for (const std::string& msisdn : draft.recipients) {
    if (!_database->prepare("INSERT INTO recipient(share, position, msisdn) VALUES(?, ?, ?)")
             .bind(id)
             .bind(position++)
             .bind(msisdn)
             .run()) {
      return false;
    }
  }
  position = 0;
  for (const ShareFile& file : draft.files) {
    if (!_database
             ->prepare("INSERT INTO file(share, position, " FILE_COLUMNS
                       ") VALUES(?, ?, ?, ?, ?, ?, ?, ?, ?)")
             .bind(id)
             .bind(position++)
             .bind(file.name)
             .bind(file.size)
             .bind(file.type)
             .bind(file.url)
             .bind(file.thumb)
             .bind(file.mid)
             .bind(file.big)
             .run()) {
      return false;
    }
  }
  return true;
}

std::optional<Share> Catalog::share(std::int64_t id) {
  common::Statement query = _database->prepare("SELECT " SHARE_COLUMNS " FROM share WHERE id = ?");
  return readOne(query.bind(id));
}

std::optional<Share> Catalog::shareByToken(const std::string& token) {
  common::Statement query =
      _database->prepare("SELECT " SHARE_COLUMNS " FROM share WHERE token = ?");
  return readOne(query.bind(token));
}

std::vector<Share> Catalog::sharesIn(ShareState state) {
  common::Statement query =
      _database->prepare("SELECT " SHARE_COLUMNS " FROM share WHERE state = ? ORDER BY id");
  return readShares(query.bind(static_cast<std::int64_t>(state)));
}

std::vector<Share> Catalog::overdue(std::int64_t nowMs) {
  common::Statement query = _database->prepare(
      "SELECT " SHARE_COLUMNS " FROM share WHERE state = 2 AND expires_ms <= ? ORDER BY id");
  return readShares(query.bind(nowMs));
}

std::optional<std::int64_t> Catalog::nextExpiryMs() {
  common::Statement query = _database->prepare("SELECT MIN(expires_ms) FROM share WHERE state = 2");
  if (!query.step()) return std::nullopt;
  return query.optionalNumber(0);
}

std::optional<ShareFile> Catalog::file(std::int64_t id, std::int64_t index) {
  common::Statement query =
      _database->prepare("SELECT " FILE_COLUMNS " FROM file WHERE share = ? AND position = ?");
  if (!query.bind(id).bind(index).step()) return std::nullopt;
  return readFile(query);
}

std::vector<ShareFile> Catalog::files(std::int64_t id) {
  std::vector<ShareFile> files;
  common::Statement query =
      _database->prepare("SELECT " FILE_COLUMNS " FROM file WHERE share = ? ORDER BY position");
  query.bind(id);
  while (query.step()) files.push_back(readFile(query));
  return files;
}

std::vector<std::string> Catalog::recipients(std::int64_t id) {
  std::vector<std::string> msisdns;
  common::Statement query =
      _database->prepare("SELECT msisdn FROM recipient WHERE share = ? ORDER BY position");
  query.bind(id);
  while (query.step()) msisdns.push_back(query.text(0));
  return msisdns;
}

bool Catalog::setState(std::int64_t id, ShareState state) {
  return _database->prepare("UPDATE share SET state = ? WHERE id = ?")
      .bind(static_cast<std::int64_t>(state))
      .bind(id)
      .run();
}

bool Catalog::prepare(std::int64_t id, std::int64_t expiresMs) {
  return _database->prepare("UPDATE share SET state = 1, expires_ms = ? WHERE id = ?")
      .bind(expiresMs)
      .bind(id)
      .run();
}

bool Catalog::publish(std::int64_t id, const std::string& manifest) {
  common::Transaction transaction(*_database);
  return _database->prepare("UPDATE share SET manifest = ? WHERE id = ?")
             .bind(manifest)
             .bind(id)
             .run() &&
         setState(id, ShareState::Open) && addEvents(id, "received", recipients(id)) &&
         transaction.commit();
}

bool Catalog::expire(std::int64_t id) {
  return setState(id, ShareState::Expired);
}

bool Catalog::recall(std::int64_t id) {
  const auto recalled = share(id);
  if (!recalled) return false;
  std::vector<std::string> told = recipients(id);
  told.push_back(recalled->sender);
  common::Transaction transaction(*_database);
  return setState(id, ShareState::Recalled) && addEvents(id, "recalled", told) &&
         transaction.commit();
}

bool Catalog::addEvents(std::int64_t id, const char* kind,
                        const std::vector<std::string>& msisdns) {
  for (const std::string& msisdn : msisdns) {
    if (!_database->prepare("INSERT INTO event(msisdn, kind, share) VALUES(?, ?, ?)")
             .bind(msisdn)
             .bind(std::string(kind))
             .bind(id)
             .run()) {
      return false;
    }
  }
  return true;
}

std::vector<Event> Catalog::events(const std::string& msisdn, std::int64_t after, int limit) {
  std::vector<Event> events;
  common::Statement query = _database->prepare(
      "SELECT event.id, kind, share.id, token, iif(kind = 'received', manifest, '') "
      "FROM event JOIN share ON share.id = event.share "
      "WHERE msisdn = ? AND event.id > ? ORDER BY event.id LIMIT ?");
  query.bind(msisdn).bind(after).bind(std::int64_t{limit});
  while (query.step()) {
    events.push_back(
        {query.number(0), query.text(1), query.number(2), query.text(3), query.text(4)});
  }
  return events;
}

std::vector<Share> Catalog::purge(std::int64_t createdBeforeMs) {
  common::Statement query = _database->prepare(
      "DELETE FROM share WHERE created_ms < ? AND state IN (0, 3, 4) "
      "RETURNING " SHARE_COLUMNS);
  return readShares(query.bind(createdBeforeMs));
}

}  // namespace service
