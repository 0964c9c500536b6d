#include "FilePlacer.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>

#include "TestFolder.h"

using downloads::placeFile;

namespace {

class FilePlacer : public testing::Test {
 protected:
  std::string place(const std::string& content, const std::string& name,
                    const std::string& earlier = {}) {
    folder.write(".part", content);
    return placeFile(folder / ".part", folder.path(), name, earlier);
  }

  TestFolder folder;
};

}  // namespace

TEST_F(FilePlacer, GivesTheFileTheNameOfTheSender) {
  EXPECT_EQ(place("new", "a.txt"), folder / "a.txt");
  EXPECT_EQ(TestFolder::read(folder / "a.txt"), "new");
  EXPECT_EQ(folder.names(), "a.txt");
}

TEST_F(FilePlacer, NumbersAFileWhoseNameHasOtherContent) {
  folder.write("a.txt", "old");
  folder.write("a (1).txt", "older");
  EXPECT_EQ(place("new", "a.txt"), folder / "a (2).txt");
  EXPECT_EQ(TestFolder::read(folder / "a.txt"), "old");
  EXPECT_EQ(TestFolder::read(folder / "a (2).txt"), "new");
}

TEST_F(FilePlacer, TakesAFileOfTheSameNameAndContentForTheNewOne) {
  folder.write("a.txt", "same");
  EXPECT_EQ(place("same", "a.txt"), folder / "a.txt");
  EXPECT_EQ(folder.names(), "a.txt");
}

TEST_F(FilePlacer, ReplacesWhatTheSameAddressGaveEarlier) {
  folder.write("a (1).txt", "first time");
  EXPECT_EQ(place("second time", "a.txt", folder / "a (1).txt"), folder / "a (1).txt");
  EXPECT_EQ(TestFolder::read(folder / "a (1).txt"), "second time");
}

TEST_F(FilePlacer, ReplacesNothingOutsideTheFolder) {
  TestFolder elsewhere;
  elsewhere.write("precious", "old");
  EXPECT_EQ(place("new", "a.txt", elsewhere / "precious"), folder / "a.txt");
  EXPECT_EQ(place("newer", "b.txt", folder.path() + "/../" + "precious"), folder / "b.txt");
  EXPECT_EQ(TestFolder::read(elsewhere / "precious"), "old");
}

TEST_F(FilePlacer, NeverWritesThroughALink) {
  TestFolder elsewhere;
  elsewhere.write("precious", "old");
  ASSERT_EQ(symlink((elsewhere / "precious").c_str(), (folder / "a.txt").c_str()), 0);
  EXPECT_EQ(place("new", "a.txt", folder / "a.txt"), folder / "a (1).txt");
  EXPECT_EQ(TestFolder::read(elsewhere / "precious"), "old");
}

TEST_F(FilePlacer, StepsAsideForAFolderOfTheSameName) {
  std::filesystem::create_directory(folder / "a.txt");
  EXPECT_EQ(place("new", "a.txt"), folder / "a (1).txt");
}

TEST_F(FilePlacer, FailsWhenThePartIsGone) {
  EXPECT_EQ(placeFile(folder / "missing", folder.path(), "a.txt", ""), "");
}
