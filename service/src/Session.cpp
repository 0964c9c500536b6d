#include "Session.h"

#include "HttpAnswer.h"

namespace service {
namespace {

constexpr char kScheme[] = "Bearer ";

}  // namespace

std::optional<std::string> authenticate(SoupServerMessage* message, Catalog& catalog) {
  const char* header = soup_message_headers_get_one(
      soup_server_message_get_request_headers(message), "Authorization");
  std::optional<std::string> owner;
  if (header && g_str_has_prefix(header, kScheme)) {
    owner = catalog.ownerOf(header + sizeof kScheme - 1);
  }
  if (!owner) {
    soup_message_headers_replace(soup_server_message_get_response_headers(message),
                                 "WWW-Authenticate", "Bearer");
    answerError(message, SOUP_STATUS_UNAUTHORIZED, "sign up first");
  }
  return owner;
}

}  // namespace service
