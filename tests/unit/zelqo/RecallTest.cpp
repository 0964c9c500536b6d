#include <gtest/gtest.h>
#include <zelqo.h>
#include <zelqo/Uploader.h>

#include <memory>

#include "FakeServer.h"
#include "FakeSettings.h"
#include "Http.h"
#include "ServiceProcess.h"
#include "TempFolder.h"
#include "TestShares.h"
#include "WaitUntil.h"

namespace {

const std::string kOwn = "+821012345678";

class Recall : public testing::Test {
 protected:
  static void answeredCb(int error, void* self) {
    auto* test = static_cast<Recall*>(self);
    test->_answers++;
    test->_error = error;
  }
  int recall(unsigned int requestId) { return zelqo_recall_upload(requestId, answeredCb, this); }
  bool answered() {
    return waitUntil([this] { return _answers > 0; });
  }
  void startService(const std::vector<std::string>& arguments = {}) {
    _service.reset();
    _service = std::make_unique<ServiceProcess>(_folder.path("data"), arguments);
    setServiceUrl(_service->url());
    setOwnNumber(kOwn);
  }
  /// Sends one file of the phone's own.
  zelqo::Uploader::Result send() {
    zelqo::Uploader uploader(_store);
    zelqo::Uploader::Request request;
    request.from = kOwn;
    request.to = {"+821099998888"};
    request.paths = {_folder.write("a.txt", "0123456789")};
    zelqo::Uploader::Result result;
    bool done = false;
    uploader.start(request, nullptr, [&](const zelqo::Uploader::Result& answer) {
      result = answer;
      done = true;
    });
    EXPECT_TRUE(waitUntil([&] { return done; }));
    EXPECT_EQ(result.error, 0) << result.reason;
    return result;
  }

  TempFolder _folder;
  std::unique_ptr<ServiceProcess> _service;
  zelqo::Store _store;
  int _answers = 0;
  int _error = 0;
};

TEST_F(Recall, TakesAShareBack) {
  startService();
  const auto sent = send();
  const std::string file = _service->url() + "/share/" + sent.token + "/file/0";
  EXPECT_EQ(httpGet(file).status, 200U);
  ASSERT_EQ(recall(static_cast<unsigned int>(sent.requestId)), 0);
  EXPECT_EQ(_answers, 0);
  ASSERT_TRUE(answered());
  EXPECT_EQ(_error, 0);
  EXPECT_EQ(httpGet(file).status, 410U);
  EXPECT_TRUE(_store.sent(sent.requestId)->recalledMs);
  runPending();
  EXPECT_EQ(_answers, 1);
}

TEST_F(Recall, MayBeRepeated) {
  startService();
  const auto id = static_cast<unsigned int>(send().requestId);
  ASSERT_EQ(recall(id), 0);
  ASSERT_TRUE(answered());
  ASSERT_EQ(recall(id), 0);
  ASSERT_TRUE(waitUntil([this] { return _answers == 2; }));
  EXPECT_EQ(_error, 0);
}

TEST_F(Recall, IsRefusedForAnUnknownShare) {
  startService();
  EXPECT_NE(recall(99999), 0);
  EXPECT_NE(recall(~0U), 0);
  EXPECT_NE(zelqo_recall_upload(1, nullptr, nullptr), 0);
  runPending();
  EXPECT_EQ(_answers, 0);
}

TEST_F(Recall, TellsThatTheServiceRefused) {
  startService();
  const auto sent = send();
  startService({"--refuse"});
  ASSERT_EQ(recall(static_cast<unsigned int>(sent.requestId)), 0);
  ASSERT_TRUE(answered());
  EXPECT_EQ(_error, ZELQO_ERROR_REFUSED);
  EXPECT_FALSE(_store.sent(sent.requestId)->recalledMs);
}

TEST_F(Recall, TellsThatTheServiceIsAway) {
  startService();
  const auto sent = send();
  _service->stop();
  ASSERT_EQ(recall(static_cast<unsigned int>(sent.requestId)), 0);
  ASSERT_TRUE(answered());
  EXPECT_EQ(_error, ZELQO_ERROR_NETWORK);
}

TEST_F(Recall, IsRefusedWithoutAService) {
  startService();
  const auto sent = send();
  setServiceUrl("");
  EXPECT_NE(recall(static_cast<unsigned int>(sent.requestId)), 0);
  runPending();
  EXPECT_EQ(_answers, 0);
}

TEST_F(Recall, AnswersOnceWhateverTheServiceSays) {
  FakeServer server([](SoupServerMessage* message, const std::string&) {
    answerWith(message, 200, std::string(100000, '['));
  });
  setServiceUrl(server.url());
  _store.addSent(sentShare(4242, "odd"));
  _store.setAccessKey(kOwn, "key");
  ASSERT_EQ(recall(4242), 0);
  ASSERT_TRUE(answered());
  EXPECT_EQ(_error, 0);
  runPending();
  EXPECT_EQ(_answers, 1);
}

}  // namespace
