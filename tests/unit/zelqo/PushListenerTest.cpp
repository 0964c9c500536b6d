#include <zelqo/PushListener.h>

#include <gtest/gtest.h>

#include <memory>

#include "FakeServer.h"
#include "FakeSettings.h"
#include "Http.h"
#include "ServiceProcess.h"
#include "TempFolder.h"
#include "WaitUntil.h"
#include "zelqo/Uploader.h"

namespace zelqo {
namespace {

const std::string kAnna = "+821011112222";
const std::string kBen = "+821012345678";

class APushListener : public testing::Test {
 protected:
  APushListener() : _store(_folder.path("phone.db")), _senders(_folder.path("sender.db")) {
    setOwnNumber("");
  }
  void startService(const std::vector<std::string>& arguments = {}) {
    _service.reset();
    _service = std::make_unique<ServiceProcess>(_folder.path("data"), arguments);
  }
  /// One file from Anna to Ben; its token.
  std::string send() {
    Uploader uploader(_senders, _service->url());
    Uploader::Request request;
    request.from = kAnna;
    request.to = {kBen};
    request.paths = {_folder.write("a.txt", "0123456789")};
    std::string token;
    bool done = false;
    uploader.start(request, nullptr, [&](const Uploader::Result& result) {
      EXPECT_EQ(result.error, 0) << result.reason;
      token = result.token;
      _lastRequest = result.requestId;
      done = true;
    });
    EXPECT_TRUE(waitUntil([&] { return done; }));
    return token;
  }
  void recall() {
    http("POST", _service->url() + "/v1/shares/" + std::to_string(_lastRequest) + "/recall", {},
         {{"Authorization", "Bearer " + _senders.accessKey(kAnna)}});
  }
  bool arrives(const std::string& token) {
    return waitUntil([&] { return _store.received(token).has_value(); });
  }

  TempFolder _folder;
  Store _store;
  Store _senders;
  std::unique_ptr<ServiceProcess> _service;
  std::int64_t _lastRequest = 0;
};

TEST_F(APushListener, WritesDownWhatArrives) {
  startService();
  PushListener listener(_store, kBen, _service->url());
  bool settled = false;
  listener.start([&settled] { settled = true; });
  ASSERT_TRUE(waitUntil([&] { return settled; }));
  const std::string token = send();
  ASSERT_TRUE(arrives(token));
  EXPECT_EQ(_store.received(token)->sender, kAnna);
  EXPECT_EQ(_store.received(token)->files.at(0).name, "a.txt");
}

TEST_F(APushListener, WritesDownARecall) {
  startService();
  PushListener listener(_store, kBen, _service->url());
  listener.start(nullptr);
  const std::string token = send();
  ASSERT_TRUE(arrives(token));
  recall();
  EXPECT_TRUE(waitUntil([&] { return _store.received(token)->recalledMs.has_value(); }));
}

TEST_F(APushListener, CatchesUpWithWhatItMissed) {
  startService();
  const std::string first = send();
  const std::string second = send();
  PushListener listener(_store, kBen, _service->url());
  listener.start(nullptr);
  EXPECT_TRUE(arrives(first));
  EXPECT_TRUE(arrives(second));
}

TEST_F(APushListener, OutlivesTheService) {
  startService();
  const std::string port = _service->port();
  PushListener listener(_store, kBen, _service->url());
  listener.start(nullptr);
  ASSERT_TRUE(arrives(send()));
  startService({"--port", port});
  EXPECT_TRUE(arrives(send()));
}

TEST_F(APushListener, SignsUpAgainWhenTheServiceHasBegunAnew) {
  startService();
  _store.setAccessKey(kBen, "of an earlier service");
  PushListener listener(_store, kBen, _service->url());
  listener.start(nullptr);
  EXPECT_TRUE(arrives(send()));
}

TEST_F(APushListener, SettlesWithoutAService) {
  PushListener listener(_store, kBen, "http://127.0.0.1:1");
  int settled = 0;
  listener.start([&settled] { settled++; });
  EXPECT_TRUE(waitUntil([&] { return settled > 0; }));
  EXPECT_EQ(settled, 1);
}

/// What a service answers to the poll after event N, for services that do not keep the rules.
class AnOddService : public APushListener {
 protected:
  /// Listens until the poll asks for what came after `cursor`.
  bool listensUpTo(std::int64_t cursor, const std::function<void(SoupServerMessage*)>& odd) {
    FakeServer server([&](SoupServerMessage* message, const std::string& path) {
      if (path == "/v1/subscribers") {
        answerWith(message, 201, R"({"key":"k"})");
      } else if (_store.pushCursor(kBen) < cursor) {
        odd(message);
      } else {
        soup_server_message_pause(message);
      }
    });
    PushListener listener(_store, kBen, server.url());
    listener.start(nullptr);
    return waitUntil([&] { return _store.pushCursor(kBen) == cursor; });
  }
};

TEST_F(AnOddService, LosesAPushThatCannotBeRead) {
  EXPECT_TRUE(listensUpTo(5, [](SoupServerMessage* message) {
    answerWith(message, 200, "no JSON");
    soup_message_headers_replace(soup_server_message_get_response_headers(message), "Push-Cursor",
                                 "5");
  }));
}

TEST_F(AnOddService, LosesAPushThatIsTooLong) {
  EXPECT_TRUE(listensUpTo(5, [](SoupServerMessage* message) {
    answerWith(message, 200, std::string(9 << 20, ' '));
    soup_message_headers_replace(soup_server_message_get_response_headers(message), "Push-Cursor",
                                 "5");
  }));
}

TEST_F(AnOddService, IsAskedAgainAfterAFailure) {
  int failures = 0;
  EXPECT_TRUE(listensUpTo(5, [&failures](SoupServerMessage* message) {
    failures++;
    const bool fails = failures < 3;
    answerWith(message, fails ? 500 : 200, fails ? "" : R"({"events":[],"cursor":5})");
  }));
  EXPECT_EQ(failures, 3);
}

TEST_F(AnOddService, CannotSendTheKeyElsewhere) {
  FakeServer elsewhere([](SoupServerMessage* message, const std::string&) {
    answerWith(message, 200, R"({"events":[],"cursor":5})");
  });
  int redirects = 0;
  EXPECT_TRUE(listensUpTo(5, [&](SoupServerMessage* message) {
    if (redirects++ == 0) {
      soup_server_message_set_redirect(message, 307, elsewhere.url("/v1/push").c_str());
    } else {
      answerWith(message, 200, R"({"events":[],"cursor":5})");
    }
  }));
  EXPECT_EQ(elsewhere.requests(), 0);
}

TEST_F(AnOddService, LosesOnlyTheEventsThatMakeNoSense) {
  EXPECT_TRUE(listensUpTo(5, [](SoupServerMessage* message) {
    answerWith(message, 200,
               R"({"cursor":5,"events":[{"kind":"received"},7,{"kind":"received",
                   "token":"0123456789abcdef","share":{"from":"+1","expires_ms":1,"files":[]}}]})");
  }));
  EXPECT_TRUE(_store.received("0123456789abcdef"));
}

}  // namespace
}  // namespace zelqo
