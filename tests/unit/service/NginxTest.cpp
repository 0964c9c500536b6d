#include <sys/wait.h>
#include <unistd.h>

#include <csignal>

#include "Pictures.h"
#include "ServiceFixture.h"

namespace {

constexpr const char* kProgram = "/usr/sbin/nginx";

std::string replaced(std::string text, const std::string& what, const std::string& by) {
  for (std::size_t at = text.find(what); at != std::string::npos; at = text.find(what)) {
    text.replace(at, what.size(), by);
  }
  return text;
}

int freePort() {
  GSocketListener* listener = g_socket_listener_new();
  const int port = g_socket_listener_add_any_inet_port(listener, nullptr, nullptr);
  g_object_unref(listener);
  return port;
}

class Nginx : public ServiceTest {
 protected:
  void SetUp() override {
    if (access(kProgram, X_OK) != 0) GTEST_SKIP() << "nginx is not there";
    const std::string port = std::to_string(freePort());
    _url = "http://127.0.0.1:" + port;
    std::string conf = replaced(readAll(NGINX_CONF), "@PORT@", port);
    // The workers of a root's nginx are another user, who may not look into the folder.
    if (geteuid() == 0) conf = "user root;\n" + conf;
    conf = replaced(replaced(conf, "@DATA@", data()), "@SERVICE@", url());
    const std::string file = _folder.write("nginx.conf", conf);
    const std::string log = data("nginx.log");
    _pid = fork();
    if (_pid == 0) {
      execl(kProgram, kProgram, "-c", file.c_str(), "-p", data().c_str(), "-e", log.c_str(),
            nullptr);
      _exit(127);
    }
    ASSERT_TRUE(eventually([this] { return httpGet(_url + "/v1/stats").status == 200; }));
  }

  void TearDown() override {
    if (_pid < 0) return;
    kill(_pid, SIGTERM);
    waitpid(_pid, nullptr, 0);
  }

  std::string behind(const TestShare& share, const std::string& path) const {
    return _url + "/share/" + share.token + "/" + path;
  }

  long long served() { return httpGet(url() + "/v1/stats").number("file"); }

 private:
  TempFolder _folder;
  std::string _url;
  pid_t _pid = -1;
};

TEST_F(Nginx, ServesTheReadSideUnchanged) {
  const std::string picture = encodedPicture(640, 480, "jpeg");
  const TestShare shared = share({{"a.jpg", "image/jpeg", picture}});
  const HttpAnswer file = httpGet(behind(shared, "file/0"));
  EXPECT_EQ(file.body, picture);
  EXPECT_EQ(served(), 0);
  EXPECT_EQ(decode(httpGet(behind(shared, "thumb/0")).body).width, 320);
  EXPECT_EQ(httpGet(behind(shared, "manifest.json")).body,
            httpGet(address(shared, "manifest.json")).body);
}

TEST_F(Nginx, ResumesWhatTheServiceBegan) {
  const TestShare shared = share({{"a.txt", "text/plain", "0123456789"}});
  const std::string tag = httpGet(address(shared, "file/0")).headers.at("ETag");
  const HttpAnswer rest =
      httpGet(behind(shared, "file/0"), {{"Range", "bytes=5-"}, {"If-Range", tag}});
  EXPECT_EQ(rest.status, 206U);
  EXPECT_EQ(rest.body, "56789");
}

TEST_F(Nginx, AnswersGoneAfterTheRecall) {
  const TestShare shared = share({{"a.txt", "text/plain", "0123456789"}});
  EXPECT_EQ(httpGet(behind(shared, "file/0")).status, 200U);
  recall(shared);
  for (const char* path : {"manifest.json", "file/0", "thumb/0"}) {
    EXPECT_EQ(httpGet(behind(shared, path)).status, 410U) << path;
  }
}

TEST_F(Nginx, ServesNothingElseOfTheFolder) {
  const TestShare shared = share({{"a.txt", "text/plain", "0123456789"}});
  for (const char* path : {"file/", "file/0/", "../../service.db", "%2e%2e/%2e%2e/service.db"}) {
    EXPECT_EQ(httpGet(behind(shared, path)).status, 404U) << path;
  }
}

}  // namespace
