// A web server on the service's folder serves what recipients read; the service is left in peace.

#include <gio/gio.h>
#include <unistd.h>

#include "AlivePage.h"

using phone::kBlue;
using phone::kGreen;
using phone::makePicture;
using phone::Share;
using phone::thePhone;

namespace {

constexpr const char* kNginx = "/usr/sbin/nginx";
constexpr const char* kServiceUrl = "db/zelqo/service_url";

int freePort() {
  GSocketListener* listener = g_socket_listener_new();
  const int port = g_socket_listener_add_any_inet_port(listener, nullptr, nullptr);
  g_object_unref(listener);
  return port;
}

void replace(std::string& text, const std::string& what, const std::string& by) {
  for (size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + by.size())) {
    text.replace(at, what.size(), by);
  }
}

class WebServer : public AlivePage {
 protected:
  void SetUp() override {
    if (access(kNginx, X_OK) != 0) GTEST_SKIP() << "nginx is not there";
    _data = thePhone().folder() + "/service";
    _url = "http://127.0.0.1:" + std::to_string(freePort());
    const std::string conf = writtenFile("nginx.conf", configuration());
    thePhone()({"shell", "sh", "-c",
                std::string(kNginx) + " -c " + conf + " -p " + _data + " -e " + log() +
                    " >/dev/null 2>&1 &"});
    thePhone()({"shell", PHONE_VCONF, "set", kServiceUrl, _url});
  }

  void TearDown() override {
    thePhone()({"shell", PHONE_VCONF, "set", kServiceUrl, serviceAddress()});
    thePhone().command({"shell", "sh", "-c", "kill $(cat " + _data + "/nginx.pid)"});
    AlivePage::TearDown();
  }

  /// What the web server answered, a line for each request.
  std::string answers() const { return contentOf(_data + "/access.log"); }

 private:
  std::string log() const { return _data + "/nginx.log"; }

  std::string configuration() const {
    std::string conf = contentOf(NGINX_CONF);
    replace(conf, "access_log off;", "access_log " + _data + "/access.log;");
    replace(conf, "@PORT@", _url.substr(_url.rfind(':') + 1));
    replace(conf, "@DATA@", _data);
    replace(conf, "@SERVICE@", serviceAddress());
    // The workers of a root's nginx are another user, who may not look into the folder.
    return geteuid() == 0 ? "user root;\n" + conf : conf;
  }

  std::string _data, _url;
};

}  // namespace

TEST_F(WebServer, ServesThePicturesOfAShareWithoutTheService) {
  const Share share = thePhone().share(
      {makePicture(thePhone(), "Green.jpg", kGreen), makePicture(thePhone(), "Blue.png", kBlue)});
  const long before = serviceCount("thumb");
  thePhone().launchReceived(share.token);
  EXPECT_TRUE(cellShows("Green.jpg", kGreen));
  EXPECT_TRUE(cellShows("Blue.png", kBlue));
  EXPECT_EQ(serviceCount("thumb"), before);
  EXPECT_NE(answers().find("/share/" + share.token + "/thumb/0"), std::string::npos) << answers();
}
