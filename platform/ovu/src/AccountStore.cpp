#include "AccountStore.h"

#include <base/PhonePaths.h>
#include <ovu.h>

#include <common/Database.h>
#include "SimCard.h"

namespace ovu {
namespace {

constexpr const char* kSchema =
    "CREATE TABLE IF NOT EXISTS account(slot INTEGER PRIMARY KEY CHECK(slot = 0), "
    "imsi TEXT NOT NULL, msisdn TEXT NOT NULL);"
    "CREATE TABLE IF NOT EXISTS service(name TEXT PRIMARY KEY, is_on INTEGER NOT NULL) "
    "WITHOUT ROWID";

constexpr std::size_t kImsiDigits = 15;

// A phone without a modem still has one identity per number.
std::string imsiFromNumber(const std::string& msisdn) {
  std::string digits;
  for (const char c : msisdn) {
    if (c >= '0' && c <= '9') digits += c;
  }
  if (digits.size() > kImsiDigits) digits.resize(kImsiDigits);
  return std::string(kImsiDigits - digits.size(), '0') + digits;
}

void report(bool* failed) {
  if (failed) *failed = true;
}

}  // namespace

struct AccountStore::Private {
  std::unique_ptr<common::Database> database;
};

AccountStore::AccountStore() : AccountStore(base::databaseFolder() + "/account.db") {}

AccountStore::AccountStore(const std::string& path) : _d(new Private) {
  _d->database = common::Database::open(path, kSchema);
}

AccountStore::~AccountStore() = default;

bool AccountStore::isOpen() const {
  return _d->database != nullptr;
}

std::optional<Account> AccountStore::account(bool* failed) const {
  if (!isOpen()) {
    report(failed);
    return {};
  }
  auto query = _d->database->prepare("SELECT imsi, msisdn FROM account");
  if (!query.step()) {
    if (query.failed()) report(failed);
    return {};
  }
  return Account{query.text(0), query.text(1)};
}

bool AccountStore::signUp(const std::string& msisdn, const std::string& imsi) {
  if (!isOpen()) return false;
  std::string identity = imsi.empty() ? simCardImsi() : imsi;
  if (identity.empty()) identity = imsiFromNumber(msisdn);
  return _d->database->prepare("INSERT OR REPLACE INTO account VALUES(0, ?, ?)")
             .bind(identity)
             .bind(msisdn)
             .run() &&
         switchService(OVU_SERVICE_SHARE, true);
}

bool AccountStore::remove() {
  return isOpen() &&
         _d->database->execute("BEGIN; DELETE FROM account; DELETE FROM service; COMMIT");
}

bool AccountStore::isServiceOn(const std::string& service, bool* failed) const {
  if (!isOpen()) {
    report(failed);
    return false;
  }
  auto query = _d->database->prepare("SELECT is_on FROM service WHERE name = ?");
  query.bind(service);
  if (query.step()) return query.number(0) != 0;
  if (query.failed()) report(failed);
  return false;
}

bool AccountStore::switchService(const std::string& service, bool on) {
  return isOpen() && _d->database->prepare("INSERT OR REPLACE INTO service VALUES(?, ?)")
                         .bind(service)
                         .bind(on ? 1 : 0)
                         .run();
}

}  // namespace ovu
