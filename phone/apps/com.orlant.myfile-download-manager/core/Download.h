#pragma once

#include <cstdint>
#include <string>

namespace downloads {

/// Stored as numbers: append only.
enum class State { Queued = 0, Running = 1, Done = 2, Failed = 3, Cancelled = 4 };

/// Why a download failed. Stored as numbers: append only.
enum class Failure {
  None = 0,
  Gone = 1,       ///< the share was recalled or expired, or never had this file
  Refused = 2,    ///< the service answered something else than the file
  Network = 3,    ///< no connection, or it broke
  Silent = 4,     ///< nothing arrived for too long
  WrongSize = 5,  ///< longer or shorter than announced
  DiskFull = 6,
  Storage = 7,  ///< the folder cannot be written
  Address = 8   ///< not an address to download from
};

struct Download {
  std::int64_t id = 0;
  std::string url;
  std::string name;        ///< as the sender wrote it: never used as a path
  std::uint64_t size = 0;  ///< bytes as announced, 0 when unknown
  std::string token;       ///< of the share
  std::string sender;
  bool wifiOnly = false;
  State state = State::Queued;
  Failure failure = Failure::None;
  std::uint64_t received = 0;  ///< bytes on disk
  std::string etag;            ///< of the bytes on disk, empty when unknown
  std::string path;            ///< where it lies when it is done

  bool isPending() const { return state == State::Queued || state == State::Running; }
};

}  // namespace downloads
