// Who may know whom: the directions of the arrows between the folders of this tree.

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <regex>
#include <string>
#include <vector>

namespace fs = std::filesystem;

namespace {

const fs::path kRoot = SOURCE_DIR;

struct Include {
  fs::path file;
  std::string name;
  bool quoted;
};

std::vector<Include> includesOf(const fs::path& folder) {
  static const std::regex kInclude(R"(^\s*#\s*include\s*([<"])([^>"]+)[>"])");
  std::vector<Include> found;
  for (const auto& entry : fs::recursive_directory_iterator(folder)) {
    const auto extension = entry.path().extension();
    if (extension != ".h" && extension != ".cpp") continue;
    std::ifstream source(entry.path());
    for (std::string line; std::getline(source, line);) {
      std::smatch match;
      if (std::regex_search(line, match, kInclude)) {
        found.push_back({entry.path(), match[2], match[1] == "\""});
      }
    }
  }
  return found;
}

std::vector<fs::path> platformFolders(const char* kind) {
  std::vector<fs::path> folders;
  for (const auto& interface : fs::directory_iterator(kRoot / "platform")) {
    const fs::path folder = interface.path() / kind;
    if (fs::is_directory(folder)) folders.push_back(folder);
  }
  return folders;
}

bool liesIn(const std::vector<fs::path>& folders, const std::string& name) {
  for (const auto& folder : folders) {
    if (fs::exists(folder / name)) return true;
  }
  return false;
}

}  // namespace

TEST(Viewer, IncludesNothingOfThisTreeButItsOwnAndThePublicPlatformHeaders) {
  const auto hidden = [] {
    auto folders = platformFolders("src");
    for (const auto& folder : platformFolders("host")) folders.push_back(folder);
    return folders;
  }();
  const auto includes = includesOf(kRoot / "viewer-new");
  ASSERT_GT(includes.size(), 50u);
  for (const auto& include : includes) {
    SCOPED_TRACE(include.file.string() + " includes " + include.name);
    if (include.quoted) {
      EXPECT_TRUE(fs::exists(kRoot / "viewer-new/inc" / include.name));
    } else {
      EXPECT_FALSE(liesIn(hidden, include.name));
    }
    EXPECT_EQ(include.name.find(".."), std::string::npos);
  }
}

TEST(PlatformLibrary, NeverReachesIntoTheViewerThePhoneOrTheService) {
  for (const auto& include : includesOf(kRoot / "platform")) {
    SCOPED_TRACE(include.file.string() + " includes " + include.name);
    EXPECT_FALSE(fs::exists(kRoot / "viewer-new/inc" / include.name));
    EXPECT_EQ(include.name.find("phone/"), std::string::npos);
    EXPECT_EQ(include.name.find("service/"), std::string::npos);
  }
}

TEST(SharingService, KnowsNeitherPlatformNorViewer) {
  auto foreign = platformFolders("include");
  for (const auto& folder : platformFolders("host")) foreign.push_back(folder);
  foreign.push_back(kRoot / "viewer-new/inc");
  for (const auto& include : includesOf(kRoot / "service")) {
    SCOPED_TRACE(include.file.string() + " includes " + include.name);
    if (!include.quoted) {
      EXPECT_FALSE(liesIn(foreign, include.name));
    } else {
      EXPECT_TRUE(fs::exists(include.file.parent_path() / include.name) ||
                  fs::exists(kRoot / "service/src" / include.name));
    }
  }
}
