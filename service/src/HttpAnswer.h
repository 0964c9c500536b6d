/// Answers to one HTTP request, and requests that are answered later.
#pragma once

#include <libsoup/soup.h>

#include <functional>
#include <string>

#include "Owned.h"

namespace service {

void answerJson(SoupServerMessage* message, guint status, const std::string& json);
/// {"error": "…"}
void answerError(SoupServerMessage* message, guint status, const char* reason);

/// A request whose answer takes time. Forgets the message by itself when the client goes away.
class HeldRequest {
 public:
  explicit HeldRequest(SoupServerMessage* message);
  ~HeldRequest();
  HeldRequest(const HeldRequest&) = delete;
  HeldRequest& operator=(const HeldRequest&) = delete;

  /// Null when the client is gone.
  SoupServerMessage* message() const { return _message.get(); }
  /// Calls `action` once, after so many milliseconds, unless released or destroyed before.
  void after(guint delayMs, std::function<void()> action);
  /// Sends the answer that the message has by now.
  void release();
  /// Leaves the message, paused as it is, to somebody else.
  void forget();

 private:
  static void finishedCb(SoupServerMessage* message, gpointer self);
  static gboolean timerCb(gpointer self);

  Ref<SoupServerMessage> _message;
  gulong _finished = 0;
  gulong _disconnected = 0;
  guint _timer = 0;
  std::function<void()> _action;
};

}  // namespace service
