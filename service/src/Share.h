/// What the service keeps of a share.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace service {

/// Preparing: everything is there, pictures are being made. Recalled and expired ones are closed
/// for good.
enum class ShareState { Draft = 0, Preparing = 1, Open = 2, Recalled = 3, Expired = 4 };

/// One file as its sender announced it. Only a lenient share may lack name, size or type; only
/// there may addresses stand in for the service's own.
struct ShareFile {
  std::optional<std::string> name;
  std::optional<std::int64_t> size;
  std::optional<std::string> type;
  std::optional<std::string> url;
  std::optional<std::string> thumb;
  std::optional<std::string> mid;
  std::optional<std::string> big;
};

struct ShareDraft {
  std::string sender;
  std::vector<std::string> recipients;
  std::vector<ShareFile> files;
  bool single = false;
  bool lenient = false;
  std::int64_t lifetimeS = 0;
};

struct Share {
  std::int64_t id = 0;
  std::string token;
  std::string sender;
  ShareState state = ShareState::Draft;
  bool single = false;
  bool lenient = false;
  std::int64_t lifetimeS = 0;
  std::int64_t createdMs = 0;
  std::int64_t expiresMs = 0;  ///< 0 until its sender has completed it
  std::int64_t fileCount = 0;

  bool closed() const { return state == ShareState::Recalled || state == ShareState::Expired; }
};

/// Something that a subscriber's phone is told.
struct Event {
  std::int64_t id = 0;
  std::string kind;  ///< "received" or "recalled"
  std::int64_t shareId = 0;
  std::string token;
  std::string manifest;  ///< JSON text, of "received" only
};

}  // namespace service
