#pragma once

#include <string>

/// A folder for one test, removed with everything in it.
class TestFolder {
 public:
  TestFolder();
  ~TestFolder();
  TestFolder(const TestFolder&) = delete;
  TestFolder& operator=(const TestFolder&) = delete;

  std::string operator/(const std::string& name) const { return _path + "/" + name; }
  const std::string& path() const { return _path; }

  void write(const std::string& name, const std::string& content) const;
  static std::string read(const std::string& path);
  /// Names in the folder, hidden ones too, sorted and joined by blanks.
  std::string names(const std::string& sub = "") const;

 private:
  std::string _path;
};
