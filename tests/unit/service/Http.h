/// A plain HTTP client that waits for its answers.
#pragma once

#include <json-glib/json-glib.h>
#include <libsoup/soup.h>

#include <map>
#include <memory>
#include <string>
#include <vector>

struct HttpAnswer {
  unsigned int status = 0;  ///< 0: no connection
  std::string body;
  std::map<std::string, std::string> headers;

  /// A member of a JSON answer as text; empty when there is none.
  std::string text(const std::string& member) const;
  long long number(const std::string& member) const;
};

using HttpHeaders = std::vector<std::pair<std::string, std::string>>;

HttpAnswer http(const char* method, const std::string& url, const std::string& body = {},
                const HttpHeaders& headers = {});
HttpAnswer httpGet(const std::string& url, const HttpHeaders& headers = {});
/// Sends a file without reading it into memory.
HttpAnswer httpSend(const std::string& url, const std::string& file, const HttpHeaders& headers);
/// Number of bytes of the answer's body, which is thrown away.
long long httpCount(const std::string& url);

using Json = std::shared_ptr<JsonNode>;
Json parseJson(const std::string& text);
