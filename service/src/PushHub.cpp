#include "PushHub.h"

#include <vector>

#include <common/Json.h>

namespace service {
namespace {

constexpr int kMaxEvents = 64;
// An answer ends after the event that passes this size.
constexpr std::size_t kAnswerSize = 1 << 20;

void writeEvent(common::JsonWriter& json, const Event& event, const std::string& publicUrl) {
  json.open()
      .number("id", event.id)
      .text("kind", event.kind)
      .text("token", event.token)
      .number("request_id", event.shareId);
  if (!publicUrl.empty()) json.text("base", publicUrl + "/share/" + event.token);
  if (const common::JsonTree manifest = common::parseJsonObject(event.manifest)) {
    json.tree("share", manifest.get());
  }
  json.close();
}

void answer(SoupServerMessage* message, const std::vector<Event>& events, std::int64_t after,
            const std::string& publicUrl) {
  common::JsonWriter json;
  json.open().openArray("events");
  std::int64_t cursor = after;
  std::size_t size = 0;
  for (const Event& event : events) {
    if (size > kAnswerSize) break;
    writeEvent(json, event, publicUrl);
    size += event.manifest.size();
    cursor = event.id;
  }
  answerJson(message, SOUP_STATUS_OK, json.closeArray().number("cursor", cursor).close().str());
  // Also outside the body: a phone that cannot take the body can still go on after it.
  soup_message_headers_replace(soup_server_message_get_response_headers(message), "Push-Cursor",
                               std::to_string(cursor).c_str());
}

}  // namespace

bool PushHub::answerEvents(SoupServerMessage* message, const std::string& msisdn,
                           std::int64_t after) {
  const std::vector<Event> events = _catalog.events(msisdn, after, kMaxEvents);
  if (events.empty()) return false;
  answer(message, events, after, _publicUrl);
  return true;
}

bool PushHub::poll(SoupServerMessage* message, const std::string& msisdn, std::int64_t after,
                   guint waitS) {
  forgetGone();
  if (answerEvents(message, msisdn, after)) return true;
  if (waitS == 0) {
    answer(message, {}, after, _publicUrl);
    return true;
  }
  Waiter& waiter = _waiters.emplace_back(message, msisdn, after);
  waiter.request.after(waitS * 1000, [this, &waiter] {
    answer(waiter.request.message(), {}, waiter.after, _publicUrl);
    waiter.request.release();
    forgetGone();
  });
  return false;
}

void PushHub::wake(const std::string& msisdn) {
  for (Waiter& waiter : _waiters) {
    if (waiter.msisdn == msisdn && waiter.request.message() &&
        answerEvents(waiter.request.message(), msisdn, waiter.after)) {
      waiter.request.release();
    }
  }
  forgetGone();
}

void PushHub::forgetGone() {
  _waiters.remove_if([](const Waiter& waiter) { return !waiter.request.message(); });
}

}  // namespace service
