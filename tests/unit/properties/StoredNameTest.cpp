#include <gtest/gtest.h>

#include <filesystem>

#include "../downloads/TestFolder.h"
#include "FileNamer.h"
#include "FilePlacer.h"
#include "Names.h"

namespace fs = std::filesystem;

TEST(StoredName, IsNeverOutsideTheFolder) {
  const TestFolder root;
  fs::create_directory(root / "downloads");
  EXPECT_TRUE(rc::check([&root] {
    const std::string name = *rc::gen::oneOf(names(), rc::gen::arbitrary<std::string>());
    root.write("downloads/.part", *rc::gen::arbitrary<std::string>());
    const fs::path path =
        downloads::placeFile(root / "downloads/.part", root / "downloads", name, "");
    RC_ASSERT(path.parent_path() == root / "downloads");
    RC_ASSERT(fs::is_regular_file(fs::symlink_status(path)));
    RC_ASSERT(path.filename().string()[0] != '.');
    RC_ASSERT(root.names() == "downloads");
    fs::remove(path);
  }));
}

TEST(StoredName, OfASafeNameIsThatName) {
  EXPECT_TRUE(rc::check([] {
    const std::string safe = downloads::safeName(*names());
    RC_ASSERT(downloads::safeName(safe) == safe);
    RC_ASSERT(safe.size() <= 255u);
  }));
}
