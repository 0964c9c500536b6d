// Files that are not opened, whatever took their place since the download: a message, and nothing
// is started.

#include <filesystem>
#include <fstream>

#include "FullPage.h"

namespace fs = std::filesystem;
using phone::thePhone;

namespace {

using NotOpened = FullPage;

std::string downloaded(const std::string& name) {
  openReceived({thePhone().makeFile(name, 50)}, name);
  EXPECT_TRUE(download());
  return ofPhone("/opt/usr/media/Downloads/" + name);
}

void replace(const std::string& path, const std::string& content) {
  fs::remove(path);
  std::ofstream(path) << content;
}

void expectRefused() {
  const std::string launches = thePhone()({"launches"});
  EXPECT_TRUE(openIsRefused());
  EXPECT_EQ(thePhone()({"launches"}), launches) << "something was started";
}

}  // namespace

TEST_F(NotOpened, IsAFileForWhichThereIsNoProgram) {
  downloaded("Thing.zzz");
  EXPECT_TRUE(openIsRefused());
}

TEST_F(NotOpened, IsAFileWithTheExecuteBit) {
  fs::permissions(downloaded("Bit.txt"), fs::perms::owner_exec, fs::perm_options::add);
  expectRefused();
}

TEST_F(NotOpened, IsADesktopEntry) {
  replace(downloaded("Entry.txt"), "[Desktop Entry]\nType=Application\nName=x\nExec=sh\n");
  expectRefused();
}

TEST_F(NotOpened, IsAScript) {
  replace(downloaded("Script.txt"), "#!/bin/sh\ntouch /opt/usr/media/gotcha\n");
  expectRefused();
}

TEST_F(NotOpened, IsADirectory) {
  const std::string path = downloaded("Folder.txt");
  fs::remove(path);
  fs::create_directory(path);
  expectRefused();
}

TEST_F(NotOpened, IsALinkToOutside) {
  const std::string path = downloaded("Link.txt");
  fs::remove(path);
  fs::create_symlink("/etc/passwd", path);
  expectRefused();
}

TEST_F(NotOpened, IsAPipe) {
  const std::string path = downloaded("Pipe.txt");
  fs::remove(path);
  thePhone()({"shell", "mkfifo", "/opt/usr/media/Downloads/Pipe.txt"});
  expectRefused();
}
