/// Shares as the phone keeps them.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace zelqo {

/// What a sender said of a file may be incomplete. Addresses are relative to the share's own, or
/// complete.
struct ReceivedFile {
  std::optional<std::string> name;
  std::optional<std::int64_t> size;  ///< bytes
  std::optional<std::string> type;   ///< MIME
  std::optional<std::string> url;
  std::optional<std::string> thumb;
  std::optional<std::string> mid;
  std::optional<std::string> big;
};

struct ReceivedShare {
  std::string token;
  std::string sender;
  std::string base;  ///< the share's own address; empty: at the phone's sharing service
  bool single = false;
  std::int64_t createdMs = 0;
  std::int64_t expiresMs = 0;
  std::optional<std::int64_t> recalledMs;
  std::vector<ReceivedFile> files;
};

struct SentShare {
  std::int64_t requestId = 0;
  std::string token;
  std::string sender;
  bool single = false;
  std::int64_t createdMs = 0;
  std::int64_t expiresMs = 0;
  std::optional<std::int64_t> recalledMs;
  std::vector<std::string> recipients;
  std::vector<std::string> paths;
};

/// One line of the history.
struct ShareSummary {
  bool received = false;
  std::string token;
  std::int64_t requestId = 0;        ///< of sent ones
  std::vector<std::string> numbers;  ///< the sender, or the recipients in order
  std::string firstFile;             ///< name of a received, path of a sent file
  std::int64_t fileCount = 0;
  bool single = false;
  std::int64_t createdMs = 0;
  std::int64_t expiresMs = 0;
  std::optional<std::int64_t> recalledMs;
};

}  // namespace zelqo
