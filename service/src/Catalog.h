/// The service's memory: subscribers, shares and what their phones are to be told.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include <common/Database.h>
#include "Share.h"

namespace service {

class Catalog {
 public:
  bool open(const std::string& path);

  /// Makes the number known and returns a new key for it; earlier keys stay valid. Empty when that
  /// fails.
  std::string signUp(const std::string& msisdn, const std::string& imsi);
  /// Whose key this is.
  std::optional<std::string> ownerOf(const std::string& key);
  /// Whether sharing is switched on; nothing for an unknown number.
  std::optional<bool> sharingOn(const std::string& msisdn);
  bool setSharing(const std::string& msisdn, bool on);

  std::optional<Share> create(const ShareDraft& draft, std::int64_t nowMs);
  std::optional<Share> share(std::int64_t id);
  std::optional<Share> shareByToken(const std::string& token);
  std::vector<Share> sharesIn(ShareState state);
  std::vector<Share> overdue(std::int64_t nowMs);
  std::optional<std::int64_t> nextExpiryMs();
  std::optional<ShareFile> file(std::int64_t id, std::int64_t index);
  std::vector<ShareFile> files(std::int64_t id);
  std::vector<std::string> recipients(std::int64_t id);

  /// The sender has handed over everything; from now on the lifetime runs.
  bool prepare(std::int64_t id, std::int64_t expiresMs);
  /// Opens the share and leaves "received" for every recipient.
  bool publish(std::int64_t id, const std::string& manifest);
  bool expire(std::int64_t id);
  /// Leaves "recalled" for sender and recipients.
  bool recall(std::int64_t id);

  std::vector<Event> events(const std::string& msisdn, std::int64_t after, int limit);

  /// Forgets shares that were created before, and are no longer in use.
  std::vector<Share> purge(std::int64_t createdBeforeMs);

 private:
  bool insertDetails(std::int64_t id, const ShareDraft& draft);
  bool setState(std::int64_t id, ShareState state);
  bool addEvents(std::int64_t id, const char* kind, const std::vector<std::string>& msisdns);

  std::unique_ptr<common::Database> _database;
};

}  // namespace service
