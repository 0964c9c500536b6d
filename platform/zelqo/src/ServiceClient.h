/// Talks JSON with the sharing service.
#pragma once

#include <functional>
#include <list>
#include <string>

#include <common/Json.h>
#include "HttpFetch.h"

namespace zelqo {

class ServiceClient {
 public:
  struct Reply {
    zelqo_error_e error = ZELQO_ERROR_NONE;
    guint status = 0;
    std::string reason;  ///< of an error, for people who read logs
    std::string body;    ///< at most 8 MiB
    std::string cursor;  ///< of a push, where to go on even when its body is of no use
    common::JsonTree json() const { return common::parseJsonObject(body); }
  };
  using ReplyCb = std::function<void(Reply)>;

  /// `url` without a slash at the end. `deadlineMs` ends each request, whatever has come by then.
  ServiceClient(std::string url, guint deadlineMs);
  ~ServiceClient();
  ServiceClient(const ServiceClient&) = delete;
  ServiceClient& operator=(const ServiceClient&) = delete;

  struct Request {
    const char* method = "GET";
    std::string path;
    std::string key;                    ///< none when empty
    std::string json;                   ///< none when empty
    std::string file;                   ///< path of a file to send instead
    std::function<void(goffset)> sent;  ///< told how many more bytes of the file have left
  };
  /// One reply, later, unless the client goes away before. False, and no reply, when there is
  /// nothing to send or nowhere to send it to.
  bool send(const Request& request, ReplyCb reply);

 private:
  struct Call;
  MessageOwner message(const Request& request) const;
  void finished(Call& call, const HttpFetch::Outcome& outcome);

  const std::string _url;
  const guint _deadlineMs;
  SessionOwner _session;
  std::list<Call> _calls;
};

}  // namespace zelqo
