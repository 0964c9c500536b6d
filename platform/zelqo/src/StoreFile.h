/// The database file of the store, which may be replaced while processes have it open.
#pragma once

#include <sys/types.h>

#include <memory>
#include <string>

#include <common/Database.h>

namespace zelqo {

class StoreFile {
 public:
  explicit StoreFile(std::string path);
  ~StoreFile();
  StoreFile(const StoreFile&) = delete;
  StoreFile& operator=(const StoreFile&) = delete;

  /// Null when it can be neither opened nor begun anew.
  common::Database* database();
  /// An operation has failed: a damaged file is moved aside, and the next call begins a new one.
  void examine();

 private:
  bool isReplaced() const;
  void open();

  std::string _path;
  std::unique_ptr<common::Database> _database;
  dev_t _device = 0;
  ino_t _inode = 0;
};

}  // namespace zelqo
