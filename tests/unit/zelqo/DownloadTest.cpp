#include <glib/gstdio.h>
#include <gtest/gtest.h>
#include <utime.h>
#include <zelqo.h>
#include <zelqo/Account.h>

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <future>
#include <memory>
#include <optional>
#include <thread>
#include <utility>
#include <vector>

#include "Downloader.h"
#include "FakeServer.h"
#include "Loop.h"
#include "ServiceProcess.h"
#include "TempFolder.h"
#include "WaitUntil.h"

namespace {

const std::string kPng = "\x89PNG\r\n\x1a\n and the rest of it";

struct Arrival {
  int error;
  std::string path;
  std::string url;
  unsigned int remaining;
};

/// Answers while the test's own main loop rests.
class ServerInAThread {
 public:
  ServerInAThread() : _thread([this] { run(); }) { _url = _ready.get_future().get(); }
  ~ServerInAThread() {
    zelqo::runIn(_context, [this] { _ends = true; });
    _thread.join();
    g_main_context_unref(_context);
  }
  ServerInAThread(const ServerInAThread&) = delete;
  ServerInAThread& operator=(const ServerInAThread&) = delete;

  const std::string& url() const { return _url; }

 private:
  void run() {
    g_main_context_push_thread_default(_context);
    {
      const FakeServer server(
          [](SoupServerMessage* message, const std::string&) { answerWith(message, 200, kPng); });
      _ready.set_value(server.url("/0"));
      while (!_ends) g_main_context_iteration(_context, TRUE);
    }
    while (g_main_context_iteration(_context, FALSE)) {
    }
    g_main_context_pop_thread_default(_context);
  }

  GMainContext* const _context = g_main_context_new();
  std::promise<std::string> _ready;
  std::string _url;
  bool _ends = false;
  std::thread _thread;
};

class Download : public testing::Test {
 protected:
  static int arrivedCb(unsigned int, int error, const char* path, const char* url,
                       unsigned int remaining, void* self) {
    EXPECT_TRUE(g_main_context_is_owner(nullptr));
    auto* test = static_cast<Download*>(self);
    test->_arrivals.push_back({error, path ? path : "", url, remaining});
    if (test->_whenArrived) test->_whenArrived();
    return 0;
  }

  int request(const std::vector<std::string>& urls) {
    std::vector<const char*> texts;
    texts.reserve(urls.size());
    for (const std::string& url : urls) texts.push_back(url.c_str());
    return zelqo_request_download(texts.data(), static_cast<unsigned int>(texts.size()),
                                  _folder.path().c_str(), 1, 0, arrivedCb, this);
  }
  /// Requests through a downloader that loses patience quickly.
  void requestFrom(zelqo::Downloader& downloader, const std::vector<std::string>& urls) {
    downloader.add(
        {urls, _folder.path(), [this](const zelqo::Downloader::Report& report) {
           _arrivals.push_back({report.error, report.path, report.url, report.remaining});
         }});
  }
  static zelqo::Downloader::Options hasty() {
    zelqo::Downloader::Options options;
    options.firstPauseMs = 1;
    options.limits.deadlineMs = 300;
    return options;
  }
  bool arrived(std::size_t count) {
    return waitUntil([&] { return _arrivals.size() >= count; });
  }
  std::vector<std::string> filesInFolder() const {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(_folder.path())) {
      names.push_back(entry.path().filename());
    }
    return names;
  }

  TempFolder _folder;
  std::vector<Arrival> _arrivals;
  std::function<void()> _whenArrived;
};

TEST_F(Download, BringsAWholePicture) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { answerWith(message, 200, kPng); });
  ASSERT_EQ(request({server.url("/share/t/thumb/0")}), 0);
  EXPECT_TRUE(_arrivals.empty());
  ASSERT_TRUE(arrived(1));
  EXPECT_EQ(_arrivals[0].error, 0);
  EXPECT_EQ(_arrivals[0].url, server.url("/share/t/thumb/0"));
  EXPECT_EQ(readAll(_arrivals[0].path), kPng);
  EXPECT_EQ(filesInFolder().size(), 1U);
}

TEST_F(Download, NamesFilesWithoutTheAddress) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { answerWith(message, 200, kPng); });
  ASSERT_EQ(request({server.url("/a%22quoted%22 and more"), server.url("/../../b"),
                     server.url("/with%20blank?q=/../c")}),
            0);
  ASSERT_TRUE(arrived(3));
  for (const std::string& name : filesInFolder()) {
    EXPECT_EQ(name.size(), 44U) << name;
    EXPECT_EQ(name.find_first_not_of("0123456789abcdef"), 40U) << name;
    EXPECT_EQ(name.substr(40), ".png");
  }
  EXPECT_EQ(filesInFolder().size(), 3U);
}

TEST_F(Download, NamesTheSameAddressTheSameAgain) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { answerWith(message, 200, kPng); });
  ASSERT_EQ(request({server.url("/a"), server.url("/a")}), 0);
  ASSERT_TRUE(arrived(2));
  EXPECT_EQ(_arrivals[0].path, _arrivals[1].path);
  EXPECT_EQ(filesInFolder().size(), 1U);
}

TEST_F(Download, CountsDownWhatRemains) {
  FakeServer server([](SoupServerMessage* message, const std::string& path) {
    answerWith(message, path == "/1" ? 404 : 200, kPng);
  });
  ASSERT_EQ(request({server.url("/0"), server.url("/1"), server.url("/2")}), 0);
  ASSERT_TRUE(arrived(3));
  EXPECT_EQ(_arrivals[0].remaining, 2U);
  EXPECT_EQ(_arrivals[2].remaining, 0U);
}

TEST_F(Download, TakesNothingButPictures) {
  FakeServer server([](SoupServerMessage* message, const std::string& path) {
    answerWith(message, 200, path == "/0" ? "<html>" : "");
  });
  ASSERT_EQ(request({server.url("/0"), server.url("/1")}), 0);
  ASSERT_TRUE(arrived(2));
  for (const Arrival& arrival : _arrivals) {
    EXPECT_NE(arrival.error, 0);
    EXPECT_EQ(arrival.path, "");
  }
  EXPECT_TRUE(filesInFolder().empty());
  EXPECT_EQ(server.requests(), 2);
}

TEST_F(Download, TakesAtMostEightMegabytes) {
  FakeServer server([](SoupServerMessage* message, const std::string&) {
    answerWith(message, 200, kPng + std::string(8 << 20, 'x'));
  });
  ASSERT_EQ(request({server.url("/0")}), 0);
  ASSERT_TRUE(arrived(1));
  EXPECT_NE(_arrivals[0].error, 0);
  EXPECT_TRUE(filesInFolder().empty());
}

TEST_F(Download, DoesNotAskAgainForWhatIsGone) {
  FakeServer server([](SoupServerMessage* message, const std::string& path) {
    answerWith(message, static_cast<unsigned>(std::stoi(path.substr(1))), kPng);
  });
  ASSERT_EQ(request({server.url("/404"), server.url("/410"), server.url("/403")}), 0);
  ASSERT_TRUE(arrived(3));
  EXPECT_EQ(server.requests(), 3);
  EXPECT_EQ(std::count_if(_arrivals.begin(), _arrivals.end(),
                          [](const Arrival& a) { return a.error == ZELQO_ERROR_GONE; }),
            1);
  EXPECT_TRUE(filesInFolder().empty());
}

TEST_F(Download, AsksAgainAfterAFailureOfTheService) {
  int left = 2;
  FakeServer server([&left](SoupServerMessage* message, const std::string&) {
    answerWith(message, left-- > 0 ? 503 : 200, kPng);
  });
  zelqo::Downloader downloader(hasty());
  requestFrom(downloader, {server.url("/0")});
  ASSERT_TRUE(arrived(1));
  EXPECT_EQ(_arrivals[0].error, 0);
  EXPECT_EQ(server.requests(), 3);
}

TEST_F(Download, GivesUpAfterThreeRetries) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { answerWith(message, 500, kPng); });
  zelqo::Downloader downloader(hasty());
  requestFrom(downloader, {server.url("/0")});
  ASSERT_TRUE(arrived(1));
  EXPECT_EQ(_arrivals[0].error, ZELQO_ERROR_NETWORK);
  EXPECT_EQ(server.requests(), 4);
}

TEST_F(Download, NeverShowsHalfAPicture) {
  FakeServer server([](SoupServerMessage* message, const std::string&) {
    answerWith(message, 200, kPng);
    soup_message_headers_set_content_length(soup_server_message_get_response_headers(message),
                                            100000);
    g_signal_connect(message, "wrote-body-data",
                     G_CALLBACK(+[](SoupServerMessage* sent, guint, gpointer) {
                       g_socket_shutdown(soup_server_message_get_socket(sent), TRUE, TRUE, nullptr);
                     }),
                     nullptr);
  });
  zelqo::Downloader downloader(hasty());
  requestFrom(downloader, {server.url("/0")});
  ASSERT_TRUE(arrived(1));
  EXPECT_NE(_arrivals[0].error, 0);
  EXPECT_TRUE(filesInFolder().empty());
}

TEST_F(Download, EndsWithASilentService) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { soup_server_message_pause(message); });
  zelqo::Downloader::Options options = hasty();
  options.limits.deadlineMs = 20;
  zelqo::Downloader downloader(options);
  requestFrom(downloader, {server.url("/0")});
  ASSERT_TRUE(arrived(1));
  EXPECT_EQ(_arrivals[0].error, ZELQO_ERROR_NETWORK);
}

TEST_F(Download, EndsInALoopOfRedirects) {
  FakeServer server([](SoupServerMessage* message, const std::string& path) {
    soup_server_message_set_redirect(message, 302, (path + "x").c_str());
  });
  zelqo::Downloader downloader(hasty());
  requestFrom(downloader, {server.url("/0")});
  ASSERT_TRUE(arrived(1));
  EXPECT_NE(_arrivals[0].error, 0);
}

TEST_F(Download, LeavesTheOthersWhenOneAddressIsNone) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { answerWith(message, 200, kPng); });
  ASSERT_EQ(request({"file:///etc/passwd", "ftp://x/y", "", "http://", "%s%n%d", "http://[",
                     server.url("/") + std::string(4096, 'a'), server.url("/good")}),
            0);
  ASSERT_TRUE(arrived(8));
  for (const Arrival& arrival : _arrivals) {
    EXPECT_EQ(arrival.error == 0, arrival.url == server.url("/good")) << arrival.url;
  }
  EXPECT_EQ(server.requests(), 1);
}

TEST_F(Download, IsRefusedForBadArguments) {
  const char* urls[] = {"http://x/", nullptr};
  const std::string folder = _folder.path();
  const std::string file = _folder.write("file", "");
  const auto refused = [&](const char** list, unsigned int count, const char* where, int priority,
                           int flags, zelqo_download_cb callback) {
    return zelqo_request_download(list, count, where, priority, flags, callback, this) != 0;
  };
  EXPECT_TRUE(refused(nullptr, 1, folder.c_str(), 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 0, folder.c_str(), 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 2, folder.c_str(), 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, nullptr, 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, "", 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, "relative", 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, file.c_str(), 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, (folder + "/none").c_str(), 1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, folder.c_str(), -1, 0, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, folder.c_str(), 1, 1, arrivedCb));
  EXPECT_TRUE(refused(urls, 1, folder.c_str(), 1, 0, nullptr));
  runPending();
  EXPECT_TRUE(_arrivals.empty());
}

TEST_F(Download, SurvivesAFolderThatVanishes) {
  FakeServer server([this](SoupServerMessage* message, const std::string&) {
    std::filesystem::remove_all(_folder.path());
    answerWith(message, 200, kPng);
  });
  ASSERT_EQ(request({server.url("/0"), server.url("/1")}), 0);
  ASSERT_TRUE(arrived(2));
  EXPECT_NE(_arrivals[0].error, 0);
  EXPECT_NE(_arrivals[1].error, 0);
}

// Answers nobody before a sixth has asked, and gives a seventh a moment to come.
TEST_F(Download, UsesAtMostSixConnections) {
  constexpr std::size_t kConnections = 6, kRequests = 48;
  std::vector<SoupServerMessage*> held;
  std::size_t most = 0;
  const auto answerAll = [](gpointer messages) -> gboolean {
    for (SoupServerMessage* message :
         std::exchange(*static_cast<std::vector<SoupServerMessage*>*>(messages), {})) {
      soup_server_message_unpause(message);
    }
    return G_SOURCE_REMOVE;
  };
  FakeServer server([&](SoupServerMessage* message, const std::string&) {
    answerWith(message, 200, kPng);
    soup_server_message_pause(message);
    held.push_back(message);
    most = std::max(most, held.size());
    if (held.size() == kConnections) g_timeout_add(20, answerAll, &held);
  });
  std::vector<std::string> urls;
  for (std::size_t i = 0; i < kRequests; i++) urls.push_back(server.url("/" + std::to_string(i)));
  ASSERT_EQ(request(urls), 0);
  ASSERT_TRUE(arrived(kRequests));
  EXPECT_EQ(most, kConnections);
}

TEST_F(Download, MayBeOrderedFromTheCallback) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { answerWith(message, 200, kPng); });
  _whenArrived = [&] {
    if (_arrivals.size() < 5) {
      EXPECT_EQ(request({server.url("/again")}), 0);
    }
  };
  ASSERT_EQ(request({server.url("/0")}), 0);
  ASSERT_TRUE(arrived(5));
}

TEST_F(Download, GoesOnWhileTheApplicationIsBusy) {
  const ServerInAThread server;
  ASSERT_EQ(request({server.url()}), 0);
  const auto isThere = [this] {
    const std::vector<std::string> names = filesInFolder();
    return !names.empty() && names[0].front() != '.';
  };
  const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(20);
  while (!isThere() && std::chrono::steady_clock::now() < deadline) std::this_thread::yield();
  EXPECT_TRUE(isThere());
  EXPECT_TRUE(_arrivals.empty());
  ASSERT_TRUE(arrived(1));
}

TEST_F(Download, EndsWithItsDownloader) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { soup_server_message_pause(message); });
  {
    zelqo::Downloader downloader(hasty());
    requestFrom(downloader, {server.url("/0"), server.url("/1")});
    ASSERT_TRUE(waitUntil([&] { return server.requests() == 2; }));
  }
  runPending();
  EXPECT_TRUE(_arrivals.empty());
  EXPECT_TRUE(filesInFolder().empty());
}

TEST_F(Download, ClearsAwayWhatAnEarlierProcessLeft) {
  FakeServer server(
      [](SoupServerMessage* message, const std::string&) { answerWith(message, 200, kPng); });
  const std::string old = _folder.write(".abc.1-2.part", "half");
  const utimbuf long_ago{1000, 1000};
  utime(old.c_str(), &long_ago);
  const std::string fresh = _folder.write(".abd.1-2.part", "half");
  ASSERT_EQ(request({server.url("/0")}), 0);
  ASSERT_TRUE(arrived(1));
  EXPECT_FALSE(std::filesystem::exists(old));
  EXPECT_TRUE(std::filesystem::exists(fresh));
}

// A service behind a certificate that it signed itself.
class SecureService : public Download {
 protected:
  void SetUp() override {
    const std::string make =
        "openssl req -x509 -newkey rsa:2048 -nodes -days 2 -subj /CN=127.0.0.1 " +
        std::string("-addext subjectAltName=IP:127.0.0.1 -keyout ") + _own.path("key.pem") +
        " -out " + _own.path("cert.pem") + " >/dev/null 2>&1 </dev/null";
    if (system(make.c_str()) != 0) {
      GTEST_SKIP() << "openssl makes the certificate, and is not there";
    }
    _service = std::make_unique<ServiceProcess>(
        _own.path("data"), std::vector<std::string>{"--tls-cert", _own.path("cert.pem"),
                                                    "--tls-key", _own.path("key.pem")});
    ASSERT_EQ(_service->url().substr(0, 8), "https://");
  }
  ServiceProcess& service() { return *_service; }
  void expectRefusal() {
    zelqo::Downloader downloader(hasty());
    requestFrom(downloader, {service().url() + "/v1/stats"});
    ASSERT_TRUE(arrived(1));
    EXPECT_EQ(_arrivals[0].error, ZELQO_ERROR_NETWORK);
  }

 private:
  const TempFolder _own;
  std::unique_ptr<ServiceProcess> _service;
};

TEST_F(SecureService, IsNotTrustedWhenNobodyVouchesForIt) {
  expectRefusal();
}

TEST_F(SecureService, LearnsNoNumberWhenNobodyVouchesForIt) {
  const TempFolder folder;
  zelqo::Store store(folder.path("zelqo.db"));
  zelqo::Account account(store, "+821012345678", service().url());
  std::optional<int> error;
  account.signUp("450051234567890", [&error](int result) { error = result; });
  ASSERT_TRUE(waitUntil([&error] { return error.has_value(); }));
  EXPECT_EQ(error, ZELQO_ERROR_NETWORK);
  EXPECT_FALSE(account.signedUp());
}

TEST_F(SecureService, EndsThoughSomebodyNeverShakesHands) {
  const common::OwnedObject<GSocketClient> client(g_socket_client_new());
  const common::OwnedObject<GSocketConnection> silent(g_socket_client_connect_to_host(
      client.get(), "127.0.0.1", static_cast<guint16>(std::stoi(service().port())), nullptr,
      nullptr));
  ASSERT_TRUE(silent);
  expectRefusal();  // by now it knows of the one before
  EXPECT_EQ(service().stop(), 0);
}

}  // namespace
