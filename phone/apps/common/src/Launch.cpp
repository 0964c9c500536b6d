#include "companion/Launch.h"

#include <notification.h>

#include <cstdlib>

#include "companion/Text.h"

namespace companion {
namespace {

constexpr const char* kViewer = "com.orlant.zelqo";
constexpr const char* kLaunchViewer = "http://tizen.org/appcontrol/operation/launch_viewer";

OwnedRequest newRequest(const char* appId, const char* operation) {
  app_control_h raw = nullptr;
  app_control_create(&raw);
  OwnedRequest request(raw);
  if (!request) return request;
  if (appId) app_control_set_app_id(raw, appId);
  app_control_set_operation(raw, operation);
  return request;
}

void send(const OwnedRequest& request) {
  if (!request ||
      app_control_send_launch_request(request.get(), nullptr, nullptr) != APP_CONTROL_ERROR_NONE) {
    showMessage(text("No app found for this action"));
  }
}

void openShare(const char* viewType, const char* token, const std::string& requestId, bool single) {
  const auto request = newRequest(kViewer, kLaunchViewer);
  if (!request) return;
  app_control_add_extra_data(request.get(), "view_type", viewType);
  app_control_add_extra_data(request.get(), "request_id", requestId.c_str());
  if (token) app_control_add_extra_data(request.get(), "contents_token", token);
  if (single) app_control_add_extra_data(request.get(), "share_type", "single_share");
  send(request);
}

}  // namespace

std::string operationOf(app_control_h request) {
  char* raw = nullptr;
  app_control_get_operation(request, &raw);
  const common::OwnedPlainText operation(raw);
  return raw ? raw : "";
}

std::string extraOf(app_control_h request, const char* key) {
  char* raw = nullptr;
  if (app_control_get_extra_data(request, key, &raw) != APP_CONTROL_ERROR_NONE) return {};
  const common::OwnedPlainText value(raw);
  return raw ? raw : "";
}

std::vector<std::string> extrasOf(app_control_h request, const char* key) {
  char** raw = nullptr;
  int count = 0;
  if (app_control_get_extra_data_array(request, key, &raw, &count) != APP_CONTROL_ERROR_NONE) {
    return {};
  }
  std::vector<std::string> values;
  for (int i = 0; i < count; i++) {
    values.emplace_back(raw[i] ? raw[i] : "");
    std::free(raw[i]);
  }
  std::free(raw);
  return values;
}

void reply(app_control_h request, app_control_result_e result, const std::string& message) {
  bool wanted = false;
  if (app_control_is_reply_requested(request, &wanted) != APP_CONTROL_ERROR_NONE || !wanted) return;
  app_control_h raw = nullptr;
  app_control_create(&raw);
  const OwnedRequest answer(raw);
  if (!answer) return;
  if (!message.empty()) app_control_add_extra_data(raw, "errorMessage", message.c_str());
  app_control_reply_to_launch_request(raw, request, result);
}

PendingReply::PendingReply(app_control_h request) {
  app_control_h copy = nullptr;
  if (app_control_clone(&copy, request) == APP_CONTROL_ERROR_NONE) _request.reset(copy);
}

PendingReply& PendingReply::operator=(PendingReply&& other) noexcept {
  send(APP_CONTROL_RESULT_CANCELED);
  _request = std::move(other._request);
  return *this;
}

PendingReply::~PendingReply() {
  send(APP_CONTROL_RESULT_CANCELED);
}

void PendingReply::send(app_control_result_e result, const std::string& message) {
  const OwnedRequest request = std::move(_request);
  if (request) reply(request.get(), result, message);
}

// The viewer reads a request id whenever it is told the kind of share.
void openReceivedShare(const std::string& token, bool single) {
  openShare("received", token.c_str(), "0", single);
}

void openSentShare(int requestId, bool single) {
  openShare("sent", nullptr, std::to_string(requestId), single);
}

void openFile(const std::string& path) {
  const auto request = newRequest(nullptr, APP_CONTROL_OPERATION_VIEW);
  if (request) app_control_set_uri(request.get(), path.c_str());
  send(request);
}

void openApplication(const char* appId) {
  send(newRequest(appId, APP_CONTROL_OPERATION_DEFAULT));
}

void showMessage(const std::string& message) {
  notification_status_message_post(message.c_str());
}

}  // namespace companion
