#include "TestFolder.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>

namespace fs = std::filesystem;

TestFolder::TestFolder() {
  std::string pattern = fs::temp_directory_path() / "downloads-XXXXXX";
  _path = mkdtemp(pattern.data());
}

TestFolder::~TestFolder() {
  fs::remove_all(_path);
}

void TestFolder::write(const std::string& name, const std::string& content) const {
  std::ofstream(_path + "/" + name, std::ios::binary) << content;
}

std::string TestFolder::read(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

std::string TestFolder::names(const std::string& sub) const {
  std::set<std::string> sorted;
  for (const auto& entry : fs::directory_iterator(fs::path(_path) / sub)) {
    sorted.insert(entry.path().filename());
  }
  std::string joined;
  for (const auto& name : sorted) joined += (joined.empty() ? "" : " ") + name;
  return joined;
}
