/// Shares for tests, in one line each.
#pragma once

#include <zelqo/Share.h>

#include <string>

inline zelqo::ReceivedShare receivedShare(const std::string& token) {
  zelqo::ReceivedShare share;
  share.token = token;
  share.sender = "+821011112222";
  share.createdMs = 1000;
  share.expiresMs = 4102444800000;
  share.files = {{"a.jpg", 100, "image/jpeg", "file/0", "thumb/0", "mid/0", "big/0"},
                 {"b.txt", 200, "text/plain", "file/1", {}, {}, {}}};
  return share;
}

inline zelqo::SentShare sentShare(std::int64_t requestId, const std::string& token) {
  zelqo::SentShare share;
  share.requestId = requestId;
  share.token = token;
  share.sender = "+821012345678";
  share.createdMs = 2000;
  share.expiresMs = 4102444800000;
  share.recipients = {"+821099998888", "+821077776666"};
  share.paths = {"/opt/usr/media/a.jpg", "/opt/usr/media/b.txt"};
  return share;
}
