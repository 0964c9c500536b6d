#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

#include "Download.h"

namespace downloads {

/// The bytes of a download that is not whole yet, under a hidden name in the download folder.
class PartFile {
 public:
  /// The hidden name that belongs to an address.
  static std::string pathFor(const std::string& folder, const std::string& url);

  explicit PartFile(const std::string& path);
  ~PartFile();
  PartFile(const PartFile&) = delete;
  PartFile& operator=(const PartFile&) = delete;

  bool isOpen() const { return _fd >= 0; }
  std::uint64_t size() const { return _size; }

  Failure append(const void* bytes, std::size_t count);
  Failure startOver();
  /// Whether the disk has room for so many more bytes.
  bool hasRoomFor(std::uint64_t bytes) const;
  /// Why the file could not be opened.
  Failure openFailure() const { return _openFailure; }

 private:
  int _fd;
  std::uint64_t _size = 0;
  Failure _openFailure = Failure::None;
};

}  // namespace downloads
