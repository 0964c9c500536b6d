#include "ZQVDownloadedFile.h"

#include <sys/stat.h>
#include <unistd.h>

#include <fstream>

#include "Items.h"
#include "PhoneTest.h"

using testing::Contains;
using testing::HasSubstr;

class DownloadedFile : public PhoneTest {
 protected:
  Items items;
};

TEST_F(DownloadedFile, IsExpectedUnderItsNameInTheDownloadFolder) {
  EXPECT_EQ(zqvDownloadedPath(items.add("a b%.jpg", 1)), "/opt/usr/media/Downloads/a b%.jpg");
}

TEST_F(DownloadedFile, NeverLeavesTheDownloadFolder) {
  for (const char* name : {"../x", "..", ".", "/etc/passwd", "a/b", ""}) {
    EXPECT_EQ(zqvDownloadedPath(items.add(name, 1)), "") << name;
  }
  ZQViewerThumbnailItem& nameless = items.add("x", 1);
  replaceText(&nameless.fileName, nullptr);
  EXPECT_EQ(zqvDownloadedPath(nameless), "");
}

TEST_F(DownloadedFile, HasNoLongerPathThan512Bytes) {
  EXPECT_EQ(zqvDownloadedPath(items.add(std::string(600, 'x'), 1)).size(), 512u);
}

TEST_F(DownloadedFile, IsNotLookedUpWithoutAnAddress) {
  ZQViewerThumbnailItem& item = items.add("x", 1);
  replaceText(&item.downloadUrl, nullptr);
  EXPECT_FALSE(zqvIsDownloaded(item));
  EXPECT_TRUE(log.lines().empty());
}

/// What may be given to another program, tried on real files.
class MayBeOpened : public PhoneTest {
 protected:
  MayBeOpened() {
    _folder = testing::TempDir() + "zelqo-open-" + std::to_string(getpid());
    mkdir(_folder.c_str(), 0700);
  }
  ~MayBeOpened() override {
    const std::string command = "rm -rf '" + _folder + "'";
    EXPECT_EQ(system(command.c_str()), 0);
  }
  std::string file(const std::string& name, const std::string& content, mode_t mode = 0600) {
    std::string path = _folder + "/" + name;
    std::ofstream(path, std::ios::binary) << content;
    chmod(path.c_str(), mode);
    return path;
  }
  bool isOpened(const std::string& path) { return zqvMayBeOpened(path.c_str()); }

  std::string _folder;
};

TEST_F(MayBeOpened, OrdinaryFiles) {
  EXPECT_TRUE(isOpened(file("a.txt", "hello\n")));
  EXPECT_TRUE(isOpened(file("a.txt", "")));
  EXPECT_TRUE(isOpened(file("b.png", "\x89PNG\r\n\x1a\n")));
  EXPECT_TRUE(isOpened(file("100% new\nline.pdf", "%PDF-1.4")));
  EXPECT_TRUE(
      isOpened(file("notes.txt", "A long and patient explanation of what a [Desktop Entry] is\n")));
  EXPECT_TRUE(log.lines().empty());
}

TEST_F(MayBeOpened, NotWithTheExecuteBit) {
  for (const mode_t mode : {0700, 0610, 0601}) {
    EXPECT_FALSE(isOpened(file("a.txt", "hello", mode)));
  }
  EXPECT_THAT(log.errors(), Contains(HasSubstr("it is executable")));
}

TEST_F(MayBeOpened, NotScriptsWhateverTheirName) {
  EXPECT_FALSE(isOpened(file("photo.jpg", "#!/bin/sh\nrm -rf /\n")));
  EXPECT_FALSE(isOpened(file("a.sh", "echo hello\n")));
}

TEST_F(MayBeOpened, NotProgramsWhateverTheirName) {
  EXPECT_FALSE(isOpened(file("photo.jpg", std::string("\177ELF\2\1\1\0", 8))));
}

TEST_F(MayBeOpened, NotDesktopEntriesWhateverTheirName) {
  EXPECT_FALSE(isOpened(file("photo.jpg", "[Desktop Entry]\nExec=sh\n")));
  EXPECT_FALSE(isOpened(file("photo.txt", "\n# nice\n\n[Desktop Entry]\nExec=sh\n")));
  EXPECT_FALSE(isOpened(file("photo.desktop", "text")));
}

TEST_F(MayBeOpened, NotFoldersLinksPipesOrMissingFiles) {
  EXPECT_FALSE(isOpened(_folder));
  const std::string link = _folder + "/link.txt";
  ASSERT_EQ(symlink(file("a.txt", "x").c_str(), link.c_str()), 0);
  EXPECT_FALSE(isOpened(link));
  const std::string pipe = _folder + "/pipe.txt";
  ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
  EXPECT_FALSE(isOpened(pipe));
  EXPECT_FALSE(isOpened(_folder + "/missing"));
}

TEST_F(MayBeOpened, NotUnreadableFiles) {
  if (geteuid() == 0) GTEST_SKIP() << "root reads everything";
  EXPECT_FALSE(isOpened(file("a.txt", "x", 0200)));
  EXPECT_THAT(log.errors(), Contains(HasSubstr("it cannot be read")));
}
