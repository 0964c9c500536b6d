// Launch requests that are wrong: a line in the log, and the next request is served.

#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>

#include "Phone.h"

using phone::Phone;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr const char* kLaunchViewer = "http://tizen.org/appcontrol/operation/launch_viewer";

class BadRequest : public ::testing::Test {
 protected:
  void TearDown() override { thePhone().closeViewer(); }

  static size_t lines() {
    const std::string log = thePhone().log();
    return std::count(log.begin(), log.end(), '\n');
  }

  /// The request leaves a line of the viewer in the log, and a good one is served afterwards.
  static void expectLoggedAndSurvived(const Words& request, const std::string& says) {
    Phone& phone = thePhone();
    SCOPED_TRACE(testing::PrintToString(request).substr(0, 200));
    const size_t before = lines();
    phone(request);
    EXPECT_TRUE(waitFor([&] {
      return lines() > before && phone.log().find(says) != std::string::npos;
    })) << phone.log();
    phone.launchReceived(phone.share({phone.makeFile("Good.txt")}).token);
    EXPECT_TRUE(waitFor([&] { return phone.tree().named("Good.txt") != nullptr; })) << phone.tree();
  }
};

}  // namespace

TEST_F(BadRequest, WithAnotherOperationIsLogged) {
  expectLoggedAndSurvived({"launch", "raw", "view", "view_type=received"}, "Invalid operation: ");
}

TEST_F(BadRequest, WithAnUnknownViewTypeIsLogged) {
  expectLoggedAndSurvived({"launch", "raw", kLaunchViewer, "view_type=backwards"},
                          "viewType error");
}

TEST_F(BadRequest, WithAnUnknownTokenIsLogged) {
  expectLoggedAndSurvived({"launch", "received", "--token", "no-such-token"}, "E/");
}

TEST_F(BadRequest, WithoutATokenIsLogged) {
  expectLoggedAndSurvived({"launch", "received", "--token", ""}, "E/");
}

TEST_F(BadRequest, WithHugeTextsIsSurvived) {
  const std::string huge(64UL * 1024, 'x');
  expectLoggedAndSurvived({"launch", "raw", kLaunchViewer, "view_type=received",
                           "contents_token=" + huge, "other=" + huge},
                          "E/");
}

TEST_F(BadRequest, WithArraysForTextsAndTextsForArraysIsSurvived) {
  expectLoggedAndSurvived({"launch", "raw", kLaunchViewer, "view_type[]=received",
                           "contents_token[]=a", "contents_token[]=b"},
                          "");
  expectLoggedAndSurvived({"launch", "raw", kLaunchViewer, "freemsg_send_data=/no/array"}, "");
}

TEST_F(BadRequest, WithInvalidUtf8IsSurvived) {
  Phone& phone = thePhone();
  // Such a request may be refused on its way already.
  phone.command({"launch", "raw", kLaunchViewer, "view_type=received", "contents_token=\xff\xfe"});
  phone.launchReceived(phone.share({phone.makeFile("Good.txt")}).token);
  EXPECT_TRUE(waitFor([&] { return phone.tree().named("Good.txt") != nullptr; })) << phone.tree();
}

namespace {

std::string manifest(const std::string& json) {
  std::string file = thePhone().makeFile("manifest.json", 0);
  std::ofstream(file) << json;
  return file;
}

}  // namespace

TEST_F(BadRequest, ForAShareThatLacksNamesSizesAndTypesShowsWhatIsWhole) {
  Phone& phone = thePhone();
  const phone::Share share = phone.share(
      {},
      {"--raw-manifest", manifest(R"([{}, {"name": null}, {"size": 0}, {"name": "Only a name.txt"},
                        {"name": "Whole.txt", "size": 5, "type": "text/plain"}])")});
  phone.launchReceived(share.token);
  EXPECT_TRUE(waitFor([&] { return phone.tree().named("Whole.txt") != nullptr; })) << phone.tree();
}

TEST_F(BadRequest, ForAShareWithoutFilesShowsAPageWithoutFiles) {
  Phone& phone = thePhone();
  const phone::Share share = phone.share({}, {"--raw-manifest", manifest("[]")});
  phone.launchReceived(share.token);
  EXPECT_TRUE(waitFor([&] {
    const phone::Tree tree = phone.tree();
    return tree.named("Download") && !tree.enables("Download") && tree.items().empty();
  })) << phone.tree();
}

TEST_F(BadRequest, ForAShareOfTenThousandFilesShowsThePage) {
  constexpr size_t kFiles = 10000;
  std::string json = "[";
  for (size_t i = 0; i < kFiles; i++) {
    json += (i ? R"(,{"name":"File )" : R"({"name":"File )") + std::to_string(i) +
            R"(.txt","size":1,"type":"text/plain"})";
  }
  Phone& phone = thePhone();
  const phone::Share share = phone.share({}, {"--raw-manifest", manifest(json + "]")});
  phone.launchReceived(share.token);
  // `phone tree` tells of the first thousand.
  EXPECT_TRUE(waitFor([&] {
    const phone::Tree tree = phone.tree();
    return tree.items().size() >= 1000 && tree.text().find("10000 files") != std::string::npos;
  })) << phone.tree();
}
