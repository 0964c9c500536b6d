/// The phone's record of what was sent and received. Every process opens its own; what one writes
/// the others read. A damaged database is moved aside and a new one begun.
#pragma once

#include <zelqo/Share.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace zelqo {

class StoreFile;

class Store {
 public:
  /// Of the phone: zelqo.db among its databases.
  Store();
  explicit Store(const std::string& path);
  ~Store();
  Store(const Store&) = delete;
  Store& operator=(const Store&) = delete;

  /// Whether the database can be used now; logged when not.
  bool usable();

  /// In place of an earlier record of the same share; its recall is remembered.
  bool addReceived(const ReceivedShare& share);
  bool addSent(const SentShare& share);
  /// Whichever of the two the share is; false only when that cannot be written.
  bool markRecalled(const std::string& token, std::int64_t whenMs);
  bool removeReceived(const std::string& token);
  bool removeSent(std::int64_t requestId);

  std::optional<ReceivedShare> received(const std::string& token);
  std::optional<SentShare> sent(std::int64_t requestId);
  /// Newest first.
  std::vector<ShareSummary> list();

  /// What opens the service for this number; empty when it has not signed up.
  std::string accessKey(const std::string& msisdn);
  bool setAccessKey(const std::string& msisdn, const std::string& key);
  /// The last push that was taken; 0 when there was none.
  std::int64_t pushCursor(const std::string& msisdn);
  bool setPushCursor(const std::string& msisdn, std::int64_t cursor);

 private:
  template <typename Work>
  bool run(const char* begin, Work work);
  template <typename Work>
  bool read(Work work);
  template <typename Work>
  bool write(Work work);

  std::unique_ptr<StoreFile> _file;
};

}  // namespace zelqo
