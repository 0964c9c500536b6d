#include "HttpAnswer.h"

#include <utility>

#include <common/Json.h>

namespace service {

void answerJson(SoupServerMessage* message, guint status, const std::string& json) {
  soup_server_message_set_status(message, status, nullptr);
  soup_message_headers_replace(soup_server_message_get_response_headers(message), "Cache-Control",
                               "no-store");
  soup_server_message_set_response(message, "application/json", SOUP_MEMORY_COPY, json.data(),
                                   json.size());
}

void answerError(SoupServerMessage* message, guint status, const char* reason) {
  answerJson(message, status, common::JsonWriter().open().text("error", reason).close().str());
}

HeldRequest::HeldRequest(SoupServerMessage* message) : _message(refer(message)) {
  soup_server_message_pause(message);
  _finished = g_signal_connect(message, "finished", G_CALLBACK(finishedCb), this);
  _disconnected = g_signal_connect(message, "disconnected", G_CALLBACK(finishedCb), this);
}

HeldRequest::~HeldRequest() {
  forget();
}

void HeldRequest::forget() {
  if (_timer) g_source_remove(std::exchange(_timer, 0));
  if (!_message) return;
  g_signal_handler_disconnect(_message.get(), _finished);
  g_signal_handler_disconnect(_message.get(), _disconnected);
  _message.reset();
}

void HeldRequest::finishedCb(SoupServerMessage*, gpointer self) {
  static_cast<HeldRequest*>(self)->forget();
}

void HeldRequest::after(guint delayMs, std::function<void()> action) {
  if (_timer) g_source_remove(_timer);
  _action = std::move(action);
  _timer = g_timeout_add(delayMs, timerCb, this);
}

gboolean HeldRequest::timerCb(gpointer self) {
  auto* held = static_cast<HeldRequest*>(self);
  held->_timer = 0;
  // The action may destroy the request.
  const std::function<void()> action = std::move(held->_action);
  action();
  return G_SOURCE_REMOVE;
}

void HeldRequest::release() {
  if (!_message) return;
  const Ref<SoupServerMessage> message = refer(_message.get());
  forget();
  soup_server_message_unpause(message.get());
}

}  // namespace service
