// Names that strangers give to files.

#include <json-glib/json-glib.h>

#include <filesystem>
#include <fstream>
#include <set>

#include "DownloadPage.h"
#include "FullPage.h"
#include "User.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

class FileNames : public DownloadPage {
 protected:
  void TearDown() override {
    DownloadPage::TearDown();
    thePhone().end({"l3afpad"});
  }

  /// A share of files of these names, written as JSON, each with bytes of its own.
  static Share named(const Words& jsonNames, Words* sources) {
    for (size_t i = 0; i < jsonNames.size(); i++) {
      sources->push_back(thePhone().makeFile("Source " + std::to_string(i), 500 + i));
    }
    const Share real = thePhone().share(*sources);
    std::string json;
    for (size_t i = 0; i < jsonNames.size(); i++) {
      json += (i ? "," : "") + std::string(R"({"name":)") + jsonNames[i] + R"(,"size":)" +
              std::to_string(500 + i) + R"(,"type":"application/octet-stream","url":")" +
              addressOf(real, "file", static_cast<int>(i)) + R"(","thumb":")" +
              addressOf(real, "thumb", static_cast<int>(i)) + R"(","mid":")" +
              addressOf(real, "mid", static_cast<int>(i)) + R"("})";
    }
    return announced("[" + json + "]");
  }

  void downloadAll(const Share& share, size_t count) const {
    ASSERT_TRUE(selectFrom(share));
    ASSERT_TRUE(tap("Select all"));
    ASSERT_TRUE(titleIs(std::to_string(count) + " selected"));
    ASSERT_TRUE(tap("Done"));
    ASSERT_TRUE(saysNow(count == 1 ? " downloaded" : std::to_string(count) + " files downloaded"));
  }

  /// Where the file of that address lies, as the download application tells.
  static std::string pathOf(const std::string& url) {
    JsonParser* parser = json_parser_new();
    std::string path;
    if (json_parser_load_from_file(
            parser,
            ofPhone("/opt/usr/apps/com.orlant.myfile-lite/shared/data/zelqo/zelqo.json").c_str(),
            nullptr)) {
      path = json_object_get_string_member_with_default(
          json_node_get_object(json_parser_get_root(parser)), url.c_str(), "");
    }
    g_object_unref(parser);
    return path;
  }

  /// Opens the page of the file with that number; taps while a page still moves have no effect.
  static testing::AssertionResult opensPage(size_t number) {
    const bool came = waitFor([=] {
      const auto tree = thePhone().tree();
      if (tree.named("Open")) return true;
      const auto cells = tree.items();
      if (cells.size() > number) thePhone()({"tap", centreOf(cells[number])});
      return false;
    });
    return came ? pageIs("Twin.txt") : testing::AssertionFailure();
  }

  /// The address of the viewer's last launch request.
  static std::string lastUri() {
    const std::string launch = thePhone().lines("launches").back();
    const std::string key = R"("uri":")";
    const size_t begin = launch.find(key);
    if (begin == std::string::npos) return {};
    const size_t uri = begin + key.size();
    return launch.substr(uri, launch.find('"', uri) - uri);
  }

  static void isPlain(const std::string& name) {
    EXPECT_EQ(name.find("\u202E"), std::string::npos) << name;
    EXPECT_EQ(name.find_first_of("\n\t\001"), std::string::npos) << name;
    EXPECT_NE(name[0], '.') << name;
    EXPECT_LE(name.size(), 255u);
  }

  /// All files of the phone but those of the applications' own data.
  static std::set<std::string> filesOfPhone() {
    std::set<std::string> files;
    for (const char* folder : {"/opt/usr/apps", "/opt/usr/media", "/opt/usr/share"}) {
      for (const auto& file : fs::recursive_directory_iterator(ofPhone(folder))) {
        const std::string path = file.path();
        if (!file.is_directory() && path.find("/data/") == std::string::npos) files.insert(path);
      }
    }
    return files;
  }
};

const Words kHostile = {R"("../../../../../tmp/escaped.txt")",
                        R"("/etc/passwd")",
                        R"("..")",
                        R"(".")",
                        R"(".hidden")",
                        R"("a/b\\c.txt")",
                        R"("line\nbreak\ttab\u0001.txt")",
                        R"("holiday\u202Egpj.exe")",
                        R"("100%s%n <b>&amp; $(reboot) `x`.txt")",
                        '"' + std::string(300, 'x') + R"(.txt")",
                        R"("Twin.xyz")",
                        R"("Twin.xyz")"};

}  // namespace

TEST_F(FileNames, NeverLeaveTheFolderNorHideThere) {
  Words sources;
  const Share share = named(kHostile, &sources);
  const auto before = filesOfPhone();
  downloadAll(share, kHostile.size());
  const auto urls = handedOver()["url"];
  ASSERT_EQ(urls.size(), kHostile.size());
  std::set<std::string> paths;
  for (size_t i = 0; i < urls.size(); i++) {
    SCOPED_TRACE(kHostile[i]);
    const fs::path path = pathOf(urls[i]);
    EXPECT_EQ(path.parent_path(), kFolder);
    EXPECT_TRUE(fs::is_regular_file(fs::symlink_status(ofPhone(path)))) << path;
    EXPECT_EQ(contentOf(ofPhone(path)), contentOf(sources[i])) << path;
    paths.insert(path);
  }
  EXPECT_EQ(paths.size(), kHostile.size()) << testing::PrintToString(paths);
  auto after = filesOfPhone();
  EXPECT_EQ(after.size(), before.size() + kHostile.size());
  for (const auto& path : before) after.erase(path);
  for (const auto& path : after) EXPECT_EQ(fs::path(path).parent_path(), ofPhone(kFolder));
  EXPECT_NE(thePhone().command({"shell", "test", "-e", "/tmp/escaped.txt"}).status, 0);
  EXPECT_TRUE(downloadedCellsAre(kHostile.size()));
  for (const auto& path : paths) isPlain(fs::path(path).filename());
}

TEST_F(FileNames, ThatAreTheSameOpenEachItsOwnBytes) {
  const Words words = {"The first.\n", "The second.\n"};
  const Share share = thePhone().share(
      {writtenFile("first/Twin.txt", words[0]), writtenFile("second/Twin.txt", words[1])});
  downloadAll(share, 2);
  for (size_t i = 0; i < words.size(); i++) {
    // Comes before the application that shows the other file.
    thePhone().launchReceived(share.token);
    const auto before = newHandOvers().size();
    ASSERT_TRUE(opensPage(i));
    ASSERT_TRUE(tap("Open"));
    ASSERT_TRUE(waitFor([&] { return newHandOvers().size() > before; }));
    EXPECT_EQ(contentOf(ofPhone(lastUri())), words[i]) << lastUri();
  }
}

TEST_F(FileNames, ThatAreOnThePhoneAlreadyReplaceNothing) {
  const std::string mine = "my own words\n";
  std::ofstream(stored("Twin.xyz")) << mine;
  Words sources;
  downloadAll(named({R"("Twin.xyz")"}, &sources), 1);
  EXPECT_EQ(contentOf(stored("Twin.xyz")), mine);
  EXPECT_EQ(contentOf(stored("Twin (1).xyz")), contentOf(sources[0]));
}

TEST_F(FileNames, ThatAreEmptyAreNotShown) {
  Words sources;
  downloadAll(named({R"("")", R"("Named.txt")"}, &sources), 1);
  EXPECT_EQ(contentOf(stored("Named.txt")), contentOf(sources[1]));
}
