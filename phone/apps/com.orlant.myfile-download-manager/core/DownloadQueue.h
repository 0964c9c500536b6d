#pragma once

#include <memory>
#include <string>
#include <vector>

#include "Download.h"

namespace common {
class Database;
}

namespace downloads {

/// The list of downloads as it survives the process: what is asked for, how far it came, where it
/// lies.
class DownloadQueue {
 public:
  explicit DownloadQueue(const std::string& file);
  ~DownloadQueue();
  DownloadQueue(const DownloadQueue&) = delete;
  DownloadQueue& operator=(const DownloadQueue&) = delete;

  /// In the order in which they were asked for. What ran when the process ended is queued again.
  std::vector<Download> load();

  /// Inserts a download whose id is 0 and gives it one; else replaces the one with that id.
  bool save(Download& download);
  bool remove(std::int64_t id);

 private:
  std::unique_ptr<common::Database> _database;
};

}  // namespace downloads
