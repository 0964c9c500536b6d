// The list of downloaded files that another application writes.

#include <filesystem>
#include <fstream>

#include "AlivePage.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;

namespace {

constexpr const char* kFolder = "/opt/usr/apps/com.orlant.myfile-lite/shared/data/zelqo";

class SharedList : public AlivePage {
 protected:
  void SetUp() override {
    fs::create_directories(ofPhone(kFolder));
    _share = thePhone().share({thePhone().makeFile("One.txt"), thePhone().makeFile("Two.txt")});
  }
  void TearDown() override {
    AlivePage::TearDown();
    fs::remove_all(path());
  }

  static std::string path() { return ofPhone(kFolder) + "/zelqo.json"; }
  std::string entry(int file, const std::string& value) const {
    return '"' + addressOf(_share, "file", file) + "\":" + value;
  }
  void expectStates(const std::string& content, const char* one, const char* two) const {
    std::ofstream(path(), std::ios::binary) << content;
    open(one, two);
  }
  void open(const char* one, const char* two) const {
    thePhone().launchReceived(_share.token);
    EXPECT_TRUE(cellIs("One.txt", one));
    EXPECT_TRUE(cellIs("Two.txt", two));
  }

 private:
  Share _share;
};

}  // namespace

TEST_F(SharedList, MarksTheFilesThatItNamesAsDownloaded) {
  std::ofstream(ofPhone("/opt/usr/media/Downloads/Renamed.txt")) << "content";
  expectStates("{" + entry(0, R"("/opt/usr/media/Downloads/Renamed.txt")") + "," +
                   entry(1, R"("/opt/usr/media/Downloads/Gone.txt")") + "}",
               "downloaded", "not downloaded");
  fs::remove(ofPhone("/opt/usr/media/Downloads/Renamed.txt"));
}

TEST_F(SharedList, WithValuesThatAreNoTextsIsReadAsEmpty) {
  expectStates("{" + entry(0, "17") + "," + entry(1, "[\"/etc/passwd\"]") + "}", "not downloaded",
               "not downloaded");
}

TEST_F(SharedList, OfNoiseIsReadAsEmpty) {
  std::string noise;
  for (unsigned i = 0; i < 20000; i++) noise += static_cast<char>(i * 2654435761u >> 24);
  expectStates(noise, "not downloaded", "not downloaded");
  expectStates(std::string(100000, '['), "not downloaded", "not downloaded");
  expectStates("[1, 2]", "not downloaded", "not downloaded");
}

TEST_F(SharedList, OfFiftyMegabytesIsNotReadAndSaidSo) {
  std::ofstream(path()) << "{" << entry(0, "\"/opt/usr/media\"");
  fs::resize_file(path(), 50'000'000);
  open("not downloaded", "not downloaded");
  EXPECT_NE(thePhone().log().find("is not a list of files"), std::string::npos) << thePhone().log();
}

TEST_F(SharedList, ThatIsADirectoryOrAPipeIsReadAsEmpty) {
  fs::create_directory(path());
  open("not downloaded", "not downloaded");
  fs::remove(path());
  thePhone()({"shell", "mkfifo", std::string(kFolder) + "/zelqo.json"});
  open("not downloaded", "not downloaded");
}
