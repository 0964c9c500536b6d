#pragma once

#include <optional>
#include <string>

namespace downloads {

/// The JSON file through which other applications learn where a downloaded file lies: one object,
/// download address to full path. Several processes may change it at the same time.
class SharedIndex {
 public:
  explicit SharedIndex(std::string file);

  std::optional<std::string> find(const std::string& url) const;

  /// Readers see the old file or the new one, never half of one. False, with a line on the log,
  /// when it cannot be written.
  bool set(const std::string& url, const std::string& path);

 private:
  std::string _file;
};

}  // namespace downloads
