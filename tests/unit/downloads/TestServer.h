#pragma once

#include <libsoup/soup.h>

#include <map>
#include <string>

#include "WaitUntil.h"

/// What the service answers for one path.
struct Answer {
  std::string body;
  std::string etag = "\"v1\"";
  unsigned int status = 200;
  std::string location;    ///< a redirect when not empty
  bool isStuck = false;    ///< sends head and half of the body, then nothing
  bool isCutOff = false;   ///< sends head and half of the body, then hangs up
  bool isChunked = false;  ///< announces no length
};

/// An HTTP service on this machine, on the test's own main context.
class TestServer {
 public:
  TestServer();
  /// Over TLS, with a certificate that nobody but itself vouches for; made in that folder.
  explicit TestServer(const std::string& certificateFolder);
  ~TestServer();
  TestServer(const TestServer&) = delete;
  TestServer& operator=(const TestServer&) = delete;

  std::string url(const std::string& path) const { return _base + path; }
  Answer& operator[](const std::string& path) { return _answers[path]; }

  int requests() const { return _requests; }
  std::string lastRange() const { return _lastRange; }
  std::size_t bytesServed() const { return _bytesServed; }

 private:
  static void _handleCb(SoupServer*, SoupServerMessage* message, const char* path, GHashTable*,
                        gpointer data);
  static void _wroteBodyDataCb(SoupServerMessage*, guint count, gpointer data);
  void _listen(SoupServerListenOptions options);
  void _handle(SoupServerMessage* message, const std::string& path);
  void _sendHalf(SoupServerMessage* message, const Answer& answer);

  SoupServer* _server;
  std::string _base;
  std::map<std::string, Answer> _answers;
  int _requests = 0;
  std::string _lastRange;
  std::size_t _bytesServed = 0;
};
