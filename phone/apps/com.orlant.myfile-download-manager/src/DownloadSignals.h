#pragma once

#include <string>

namespace downloads {

/// Tells whoever shows a shared file how its download goes: signals on the system bus, with the
/// file's address.
class DownloadSignals {
 public:
  void downloading(const std::string& url) { _emit("file_downloading", url); }
  void downloaded(const std::string& url) { _emit("file_downloaded", url); }

 private:
  void _emit(const char* member, const std::string& url);
};

}  // namespace downloads
