// Thumbnails that are none, and addresses that lead astray.

#include <filesystem>
#include <set>

#include "AlivePage.h"

namespace fs = std::filesystem;
using phone::Colour;
using phone::kGreen;
using phone::kRed;
using phone::makePicture;
using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

using BadThumbnails = AlivePage;

std::string entry(const std::string& name, const std::string& thumb) {
  return R"({"name":")" + name + R"(","size":9,"type":"image/png","url":"http://127.0.0.1:9/)" +
         name + R"(","thumb":")" + thumb + R"(","mid":")" + thumb + R"("})";
}

// Everything below the phone's folder for applications and media, but not what is known to change.
std::set<std::string> filesOfPhone() {
  std::set<std::string> files;
  for (const char* folder : {"/opt/usr/apps", "/opt/usr/media", "/opt/usr/share"}) {
    for (const auto& file : fs::recursive_directory_iterator(ofPhone(folder))) {
      const std::string path = file.path();
      const bool isExpected = path.find("/com.orlant.zelqo/shared/data/") != std::string::npos ||
                              path.find("/data/.pref") != std::string::npos;
      if (!isExpected) files.insert(path);
    }
  }
  return files;
}

}  // namespace

TEST_F(BadThumbnails, LeaveTheIconOfTheirKind) {
  const std::string whole = contentOf(makePicture(thePhone(), "Whole.png", kRed, 600, 600));
  const Share source = thePhone().share(
      {writtenFile("Cut.png", whole.substr(0, whole.size() / 3)),
       writtenFile("Huge.png", phone::pngHeader(20000, 20000)), writtenFile("Empty.png", ""),
       writtenFile("Text.png", "Just words.\n"), makePicture(thePhone(), "Good.png", kGreen)});
  std::string files;
  const char* names[] = {"Cut.png", "Huge.png", "Empty.png", "Text.png", "Good.png"};
  for (int i = 0; i < 5; i++) {
    files += (i ? "," : "[") + entry(names[i], addressOf(source, "file", i));
  }
  thePhone().launchReceived(announced(files + "]").token);
  ASSERT_TRUE(cellShows("Good.png", kGreen));
  const std::string before = viewerProcess();
  ASSERT_TRUE(waitFor([] { return thePhone().log().find("was not fetched") != std::string::npos; }))
      << thePhone().log();
  for (const char* name : {"Huge.png", "Empty.png", "Text.png"}) {
    EXPECT_FALSE(colourOf(thePhone(), name).isAbout(kRed)) << name;
    EXPECT_FALSE(colourOf(thePhone(), name).isAbout(Colour{})) << name;
  }
  for (const char* name : names) {
    thePhone()({"tap", name});
    ASSERT_TRUE(goes("Files from")) << name;
    thePhone()({"key", "Escape"});
    ASSERT_TRUE(comes("Files from"));
  }
  EXPECT_EQ(viewerProcess(), before);
}

TEST_F(BadThumbnails, WriteNothingOutsideTheirFolders) {
  const Share source = thePhone().share({makePicture(thePhone(), "Good.png", kGreen)});
  const std::string good = addressOf(source, "thumb", 0);
  const std::string files = "[" + entry("a.png", good + "?with spaces and 'quotes' \\\"both\\\"") +
                            "," + entry("b.png", good + "?../../../../../../opt/usr/media/x.png") +
                            "," + entry("c.png", good + "/../../../../../opt/usr/media/y.png") +
                            "," + entry("d.png", good + "?" + std::string(4096, 'z')) + "," +
                            entry("e.png", "file:///etc/passwd") + "," +
                            entry("f.png", "../../thumb/0") + "," + entry("g.png", "") + "," +
                            entry("h.png", "%s%n%s%n") + "," + entry("Last.png", good) + "]";
  const auto before = filesOfPhone();
  thePhone().launchReceived(announced(files).token);
  ASSERT_TRUE(cellShows("Last.png", kGreen));
  ASSERT_TRUE(waitFor([] {
    return thePhone().log().find("not an address to fetch from") != std::string::npos;
  })) << thePhone().log();
  EXPECT_EQ(filesOfPhone(), before);
  for (const char* folder : {kThumbnails, kMidThumbnails}) {
    for (const auto& file : fs::directory_iterator(ofPhone(folder))) {
      EXPECT_TRUE(file.is_regular_file()) << file.path();
    }
  }
}
