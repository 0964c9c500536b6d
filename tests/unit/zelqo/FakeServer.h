/// An HTTP server on the test's own main loop that answers as the test says.
#pragma once

#include <libsoup/soup.h>

#include <functional>
#include <string>

class FakeServer {
 public:
  using Handler = std::function<void(SoupServerMessage* message, const std::string& path)>;

  explicit FakeServer(Handler handler);
  ~FakeServer();
  FakeServer(const FakeServer&) = delete;
  FakeServer& operator=(const FakeServer&) = delete;

  std::string url(const std::string& path = {}) const { return _url + path; }
  int requests() const { return _requests; }

 private:
  static void requestCb(SoupServer*, SoupServerMessage* message, const char* path, GHashTable*,
                        gpointer self);

  Handler _handler;
  SoupServer* _server;
  std::string _url;
  int _requests = 0;
};

void answerWith(SoupServerMessage* message, unsigned status, const std::string& body);
