// Who knows a share's token can read it, and who has the account's key is the subscriber.

#include <common/Database.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <sstream>

#include "Companions.h"
#include "Journey.h"

namespace fs = std::filesystem;
using phone::thePhone;

namespace {

/// The mode of what belongs to nobody but its owner has none of these.
constexpr mode_t kOthers = S_IRWXG | S_IRWXO;

class Secrets : public testing::Test {
 protected:
  /// Leaves behind whatever the applications write on their ways.
  static void SetUpTestSuite() {
    thePhone().closeViewer();
    _journey = std::make_unique<Journey>();
    LoopWatch watch;
    ASSERT_TRUE(_journey->go(watch));
    ASSERT_FALSE(_journey->received().token.empty() || _journey->sent().token.empty());
  }
  static void TearDownTestSuite() {
    _journey.reset();
    thePhone().closeViewer();
    thePhone().end({"contacts-picker", "download-manager"});
  }

  static std::vector<std::string> all() {
    std::vector<std::string> secrets{_journey->received().token, _journey->sent().token};
    const auto store =
        common::Database::open(thePhone().folder() + "/opt-usr/dbspace/zelqo.db", "");
    if (!store) return {};
    common::Statement accounts =
        store->prepare("SELECT access_key FROM account WHERE access_key != ''");
    while (accounts.step()) secrets.push_back(accounts.text(0));
    return secrets;
  }
  static std::string contentOf(const fs::path& file) {
    std::ostringstream text;
    text << std::ifstream(file, std::ios::binary).rdbuf();
    return text.str();
  }

  static std::unique_ptr<Journey> _journey;
};

std::unique_ptr<Journey> Secrets::_journey;

}  // namespace

TEST_F(Secrets, AreInNoLog) {
  const std::vector<std::string> secrets = all();
  ASSERT_GT(secrets.size(), 2U);
  int logs = 0;
  for (const char* folder : {"log", "run/log"}) {
    for (const auto& log : fs::directory_iterator(fs::path(thePhone().folder()) / folder)) {
      const std::string text = contentOf(log.path());
      for (const auto& secret : secrets) {
        EXPECT_EQ(text.find(secret), std::string::npos) << log.path();
      }
      logs++;
    }
  }
  EXPECT_GT(logs, 10);
}

TEST_F(Secrets, LieInFilesThatNobodyElseReads) {
  const fs::path phone = fs::path(thePhone().folder()) / "opt-usr";
  std::vector<fs::path> folders{phone / "dbspace"};
  for (const auto& application : fs::directory_iterator(phone / "apps")) {
    const fs::path data = application.path() / "data";
    if (fs::exists(data)) folders.push_back(data);
  }
  int files = 0;
  for (const auto& folder : folders) {
    struct stat status;
    ASSERT_EQ(stat(folder.c_str(), &status), 0) << folder;
    EXPECT_EQ(status.st_mode & kOthers, 0U) << folder;
    for (const auto& entry : fs::recursive_directory_iterator(folder)) {
      ASSERT_EQ(stat(entry.path().c_str(), &status), 0) << entry.path();
      EXPECT_EQ(status.st_mode & kOthers, 0U) << entry.path();
      files++;
    }
  }
  EXPECT_GT(files, 5);
}
