/// A folder of the test's own, gone with it.
#pragma once

#include <string>

class TempFolder {
 public:
  TempFolder();
  ~TempFolder();
  TempFolder(const TempFolder&) = delete;
  TempFolder& operator=(const TempFolder&) = delete;

  std::string path(const std::string& name = {}) const;
  /// Writes a file into it and gives its path.
  std::string write(const std::string& name, const std::string& content) const;

 private:
  std::string _path;
};

std::string readAll(const std::string& path);
