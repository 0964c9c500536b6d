#include <zelqo/Account.h>
#include <zelqo/Uploader.h>

#include <gtest/gtest.h>
#include <zelqo.h>

#include "FakeSettings.h"
#include "Http.h"
#include "Pictures.h"
#include "ServiceProcess.h"
#include "TempFolder.h"
#include "WaitUntil.h"

namespace zelqo {
namespace {

const std::string kOwn = "+821012345678";

class AnUploader : public testing::Test {
 protected:
  AnUploader() : _store(_folder.path("zelqo.db")), _service(_folder.path("data"), {"--lenient"}) {
    setOwnNumber(kOwn);
    setServiceUrl(_service.url());
  }
  Uploader::Request request(const std::string& from, const std::vector<std::string>& paths) {
    Uploader::Request request;
    request.from = from;
    request.to = {"+821099998888", "+821077776666"};
    request.paths = paths;
    return request;
  }
  Uploader::Result run(const Uploader::Request& request) {
    Uploader uploader(_store);
    Uploader::Result result;
    bool done = false;
    EXPECT_TRUE(uploader.start(
        request,
        [this](std::int64_t sent, std::int64_t total) {
          _progress = {sent, total};
        },
        [&](const Uploader::Result& answer) {
          result = answer;
          done = true;
        }));
    EXPECT_FALSE(uploader.start(request, nullptr, nullptr));
    EXPECT_TRUE(waitUntil([&] { return done; }));
    return result;
  }
  std::string address(const Uploader::Result& result, const std::string& path) const {
    return _service.url() + "/share/" + result.token + "/" + path;
  }

  TempFolder _folder;
  Store _store;
  ServiceProcess _service;
  std::pair<std::int64_t, std::int64_t> _progress;
};

TEST_F(AnUploader, SendsFilesAndRemembersThem) {
  const std::string picture = encodedPicture(800, 600, "jpeg");
  const std::vector<std::string> paths = {_folder.write("a b%s.jpg", picture),
                                          _folder.write("b.txt", "text")};
  const auto result = run(request(kOwn, paths));
  ASSERT_EQ(result.error, 0) << result.reason;
  EXPECT_EQ(httpGet(address(result, "file/0")).body, picture);
  EXPECT_EQ(httpGet(address(result, "file/1")).body, "text");
  EXPECT_EQ(decode(httpGet(address(result, "thumb/0")).body).width, 320);
  EXPECT_NE(httpGet(address(result, "manifest.json")).body.find("\"a b%s.jpg\""),
            std::string::npos);
  const auto sent = _store.sent(result.requestId);
  ASSERT_TRUE(sent);
  EXPECT_EQ(sent->token, result.token);
  EXPECT_EQ(sent->paths, paths);
  EXPECT_EQ(sent->recipients.size(), 2U);
  EXPECT_EQ(_progress.first, _progress.second);
  EXPECT_EQ(_progress.second, static_cast<std::int64_t>(picture.size()) + 4);
}

TEST_F(AnUploader, SendsAnEmptyFile) {
  const auto result = run(request(kOwn, {_folder.write("empty.txt", "")}));
  ASSERT_EQ(result.error, 0) << result.reason;
  EXPECT_EQ(httpGet(address(result, "file/0")).status, 200U);
}

TEST_F(AnUploader, RemembersNothingOfOtherNumbers) {
  const auto result = run(request("+821011112222", {_folder.write("b.txt", "text")}));
  ASSERT_EQ(result.error, 0) << result.reason;
  EXPECT_FALSE(_store.sent(result.requestId));
}

TEST_F(AnUploader, RefusesWhatIsNoReadableFile) {
  for (const std::string& path :
       {_folder.path(), _folder.path("none"), std::string("/dev/null"), std::string()}) {
    const auto result = run(request(kOwn, {path}));
    EXPECT_EQ(result.error, ZELQO_ERROR_INVALID_PARAMETER) << path;
    EXPECT_NE(result.reason, "");
  }
}

TEST_F(AnUploader, TellsWhyTheServiceRefused) {
  auto odd = request(kOwn, {_folder.write("b.txt", "text")});
  odd.to = {"nobody"};
  const auto result = run(odd);
  EXPECT_EQ(result.error, ZELQO_ERROR_REFUSED);
  EXPECT_EQ(result.reason, "to: numbers in international form");
}

TEST_F(AnUploader, TellsThatTheServiceIsAway) {
  const auto file = _folder.write("b.txt", "text");
  _service.stop();
  EXPECT_EQ(run(request(kOwn, {file})).error, ZELQO_ERROR_NETWORK);
  setServiceUrl("");
  EXPECT_EQ(run(request(kOwn, {file})).error, ZELQO_ERROR_NETWORK);
}

TEST_F(AnUploader, SignsUpAnewWhenItsKeyIsNotKnown) {
  _store.setAccessKey(kOwn, "stale");
  const auto result = run(request(kOwn, {_folder.write("b.txt", "text")}));
  EXPECT_EQ(result.error, 0) << result.reason;
}

TEST_F(AnUploader, AnnouncesARawManifest) {
  auto raw = request(kOwn, {});
  raw.rawFiles = R"([{"name":"x"},{}])";
  const auto result = run(raw);
  ASSERT_EQ(result.error, 0) << result.reason;
  EXPECT_NE(httpGet(address(result, "manifest.json")).body.find(R"({"name":"x","url":"file/0"})"),
            std::string::npos);
  raw.rawFiles = "{";
  EXPECT_EQ(run(raw).error, ZELQO_ERROR_INVALID_PARAMETER);
}

TEST_F(AnUploader, EndsWithoutAWordWhenItGoes) {
  bool done = false;
  {
    Uploader uploader(_store);
    uploader.start(request(kOwn, {_folder.write("b.txt", "text")}), nullptr,
                   [&done](const Uploader::Result&) { done = true; });
    g_main_context_iteration(nullptr, FALSE);
  }
  runPending();
  EXPECT_FALSE(done);
}

TEST_F(AnUploader, CannotSendWhileSharingIsSwitchedOff) {
  Account account(_store, kOwn);
  int answers = 0;
  bool isOn = true;
  int failed = 0;
  const auto count = [&](int error, bool on) {
    answers++;
    failed = error;
    isOn = on;
  };
  account.signUp("450051012345678", [&](int error) { count(error, true); });
  ASSERT_TRUE(waitUntil([&] { return answers == 1; }));
  EXPECT_EQ(failed, 0);
  EXPECT_TRUE(account.signedUp());
  account.switchSharing(false, count);
  ASSERT_TRUE(waitUntil([&] { return answers == 2; }));
  EXPECT_FALSE(isOn);
  EXPECT_EQ(run(request(kOwn, {_folder.write("b.txt", "text")})).error, ZELQO_ERROR_REFUSED);
  account.switchSharing(true, count);
  ASSERT_TRUE(waitUntil([&] { return answers == 3; }));
  account.querySharing(count);
  ASSERT_TRUE(waitUntil([&] { return answers == 4; }));
  EXPECT_TRUE(isOn);
  EXPECT_EQ(failed, 0);
}

}  // namespace
}  // namespace zelqo
