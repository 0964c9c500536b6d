#include "TempFolder.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>

TempFolder::TempFolder() {
  std::string name = (std::filesystem::temp_directory_path() / "sharing-XXXXXX").string();
  _path = mkdtemp(name.data());
}

TempFolder::~TempFolder() {
  std::error_code ignored;
  std::filesystem::remove_all(_path, ignored);
}

std::string TempFolder::path(const std::string& name) const {
  return name.empty() ? _path : _path + "/" + name;
}

std::string TempFolder::write(const std::string& name, const std::string& content) const {
  std::ofstream(path(name), std::ios::binary) << content;
  return path(name);
}

std::string readAll(const std::string& path) {
  std::ostringstream content;
  content << std::ifstream(path, std::ios::binary).rdbuf();
  return content.str();
}
