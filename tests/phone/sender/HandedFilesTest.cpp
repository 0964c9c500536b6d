// Files that another application hands over with its launch request.

#include "Screen.h"

using phone::thePhone;
using phone::Tree;
using phone::Words;

namespace {

class HandedFiles : public Sending {
 protected:
  void SetUp() override {
    Sending::SetUp();
    thePhone()({"shell", "mkdir", "-p", kFolder});
  }
  void TearDown() override {
    thePhone().command({"shell", "rm", "-rf", kFolder});
    Sending::TearDown();
  }

  /// Paths of the phone's own, whether there is something or not.
  static void hand(const Words& paths) {
    Words words = {"launch", "raw", "http://tizen.org/appcontrol/operation/launch_viewer"};
    for (const std::string& path : paths) words.push_back("freemsg_send_data[]=" + path);
    thePhone()(words);
  }

  /// The file is left out, with that line; the good one next to it is shown.
  void expectDropped(const std::string& path, const std::string& line) const {
    hand({path, thePhone().makeFile("Good.txt")});
    EXPECT_TRUE(logs(line));
    EXPECT_TRUE(shows(thePhone(), 1));
    EXPECT_TRUE(thePhone().tree().named("Good.txt")) << thePhone().tree();
  }

  static constexpr const char* kFolder = "/opt/usr/media/odd";
  static std::string odd(const std::string& name) { return std::string(kFolder) + "/" + name; }
  static constexpr const char* kNoSize = "service error! fileSize is 0!";
};

}  // namespace

TEST_F(HandedFiles, FillTheScreenAlone) {
  const phone::Phone& phone = thePhone();
  phone({"launch", "files", phone.makeFile("a.txt"), phone.makeFile("b.pdf"),
         phone.makeFile("c.xyz")});
  ASSERT_TRUE(shows(phone, 3));
  const Tree tree = phone.tree();
  EXPECT_FALSE(tree.named("Recall")) << tree;
  EXPECT_FALSE(tree.named("Reshare")) << tree;
  EXPECT_FALSE(tree.named("Recipient")) << tree;
  EXPECT_TRUE(tree.withRole("list").empty()) << tree;
  ASSERT_TRUE(tap(phone, "Back"));
  EXPECT_TRUE(viewerEnds(phone));
}

TEST_F(HandedFiles, ThatAreMissingAreLeftOut) {
  expectDropped(odd("missing.jpg"), kNoSize);
}

TEST_F(HandedFiles, ThatAreDanglingLinksAreLeftOut) {
  thePhone()({"shell", "ln", "-s", "/nowhere/at/all.mp4", odd("link.mp4")});
  expectDropped(odd("link.mp4"), kNoSize);
}

TEST_F(HandedFiles, ThatAreEmptyAreLeftOut) {
  thePhone()({"shell", "touch", odd("empty.png")});
  expectDropped(odd("empty.png"), kNoSize);
}

TEST_F(HandedFiles, ThatAreSocketsAreLeftOut) {
  thePhone()({"shell", "python3", "-c",
              "import socket; socket.socket(socket.AF_UNIX).bind('" + odd("door.txt") + "')"});
  expectDropped(odd("door.txt"), kNoSize);
}

TEST_F(HandedFiles, WithoutAnExtensionAreLeftOut) {
  expectDropped("/nodot/file", "name[0] is NULL");
}

TEST_F(HandedFiles, WithEndlessPathsAreLeftOut) {
  expectDropped("/" + std::string(4090, 'x') + ".txt", kNoSize);
}

TEST_F(HandedFiles, WithQuotesAndPercentSignsInTheirNamesAreShown) {
  const std::string name = "It's 100%s \"%n\" <b>&amp;.txt";
  hand({thePhone().makeFile(name)});
  ASSERT_TRUE(shows(thePhone(), 1));
  EXPECT_TRUE(thePhone().tree().named(name)) << thePhone().tree();
}

TEST_F(HandedFiles, ThatAreFoldersOrNotForThisUserDoNoHarm) {
  thePhone()({"shell", "mkdir", "-p", odd("folder.jpg")});
  thePhone()({"shell", "sh", "-c", "echo x > $0; chmod 0 $0", odd("secret.jpg")});
  hand({odd("folder.jpg"), odd("secret.jpg"), thePhone().makeFile("Good.txt")});
  ASSERT_TRUE(comes(thePhone(), "Good.txt"));
  ASSERT_TRUE(tap(thePhone(), "Good.txt"));
  EXPECT_TRUE(comes(thePhone(), "Open"));
}

TEST_F(HandedFiles, ThatAreAllMissingGiveAnEmptyPage) {
  hand({odd("a.jpg"), odd("b.jpg")});
  ASSERT_TRUE(comes(thePhone(), "Shared files"));
  EXPECT_TRUE(thePhone().tree().items().empty()) << thePhone().tree();
}

TEST_F(HandedFiles, MayBeThousands) {
  Words paths;
  const std::string file = thePhone().makeFile("One of many.txt");
  for (int i = 0; i < 1000; i++) paths.push_back(file);
  hand(paths);
  EXPECT_TRUE(shows(thePhone(), 1000));
}
