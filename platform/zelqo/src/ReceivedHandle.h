/// A received share as the library's users hold it.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "zelqo/Share.h"

namespace zelqo {

class ReceivedHandle {
 public:
  /// What the store says now. `sender` outlives the handle.
  void set(ReceivedShare share, char* sender, const std::string& serviceUrl);
  /// Frees the memory of the files; they are there again after the next set().
  void dropFiles();

  const std::string& token() const { return _token; }
  char* sender() const { return _sender; }
  std::size_t fileCount() const { return _fileCount; }
  bool hasFiles() const { return _files.size() == _fileCount; }
  const ReceivedFile& file(std::size_t index) const { return _files[index]; }
  /// Milliseconds since the epoch. A recalled share has ended before its recall.
  std::int64_t endMs() const { return _endMs; }
  /// Completes a file's address; nothing when that takes a service which the phone does not have.
  std::optional<std::string> address(const std::optional<std::string>& address) const;

 private:
  std::string _token;
  std::string _base;
  char* _sender = nullptr;
  std::size_t _fileCount = 0;
  std::vector<ReceivedFile> _files;
  std::int64_t _endMs = 0;
};

}  // namespace zelqo
