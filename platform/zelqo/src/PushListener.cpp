#include "zelqo/PushListener.h"

#include <algorithm>
#include <charconv>
#include <utility>

#include "ServiceClient.h"
#include "zelqo/Account.h"

namespace zelqo {
namespace {

// The service answers after 25 seconds when there is nothing to tell.
constexpr guint kDeadlineMs = 40000;
constexpr unsigned int kFirstPauseMs = 100;
constexpr unsigned int kLongestPauseMs = 1000;
constexpr guint kOk = 200;
constexpr guint kUnauthorized = 401;

}  // namespace

PushListener::PushListener(Store& store, std::string msisdn, const std::string& serviceUrl)
    : _store(store),
      _msisdn(std::move(msisdn)),
      _client(std::make_unique<ServiceClient>(serviceUrl, kDeadlineMs)),
      _account(std::make_unique<Account>(store, _msisdn, serviceUrl)),
      _pauseMs(kFirstPauseMs) {}

PushListener::~PushListener() {
  if (_retry) g_source_remove(_retry);
}

void PushListener::start(std::function<void()> settled) {
  _settled = std::move(settled);
  proceed();
}

void PushListener::proceed() {
  if (_account->signedUp()) {
    poll();
  } else {
    signUp();
  }
}

void PushListener::signUp() {
  _account->signUp("", [this](int error) {
    if (error) {
      tryAgain();
    } else {
      poll();
    }
  });
}

void PushListener::poll() {
  const common::OwnedText number(g_uri_escape_string(_msisdn.c_str(), nullptr, FALSE));
  ServiceClient::Request request;
  request.path = std::string("/v1/push?msisdn=") + number.get() +
                 "&after=" + std::to_string(_store.pushCursor(_msisdn));
  request.key = _store.accessKey(_msisdn);
  const bool sent = _client->send(request, [this](const ServiceClient::Reply& reply) {
    if (reply.status == kUnauthorized) {
      // The service has begun anew, or the key was another one's.
      _store.setAccessKey(_msisdn, "");
      tryAgain();
      return;
    }
    const auto push = reply.error ? std::nullopt : readPush(reply.body);
    if (push) {
      take(*push);
    } else if (reply.status == kOk && skipTo(reply.cursor)) {
      poll();
    } else {
      tryAgain();
    }
  });
  if (sent) {
    settle();
  } else {
    tryAgain();
  }
}

void PushListener::take(const Push& push) {
  for (const PushEvent& event : push.events) {
    if (!record(event)) {
      tryAgain();
      return;
    }
  }
  if (push.cursor != _store.pushCursor(_msisdn) && !_store.setPushCursor(_msisdn, push.cursor)) {
    tryAgain();
    return;
  }
  _pauseMs = kFirstPauseMs;
  poll();
}

bool PushListener::record(const PushEvent& event) {
  if (event.kind == PushEvent::Kind::Received) return _store.addReceived(event.share);
  return _store.markRecalled(event.share.token, g_get_real_time() / 1000);
}

// What cannot be read this time cannot be read next time either.
bool PushListener::skipTo(const std::string& cursor) {
  std::int64_t number = 0;
  const auto result = std::from_chars(cursor.data(), cursor.data() + cursor.size(), number);
  if (result.ec != std::errc() || number <= _store.pushCursor(_msisdn)) return false;
  g_warning("zelqo: a push that cannot be read is left out");
  return _store.setPushCursor(_msisdn, number);
}

void PushListener::tryAgain() {
  settle();
  _retry = g_timeout_add(_pauseMs, retryCb, this);
  _pauseMs = std::min(_pauseMs * 2, kLongestPauseMs);
}

int PushListener::retryCb(void* self) {
  auto* listener = static_cast<PushListener*>(self);
  listener->_retry = 0;
  listener->proceed();
  return G_SOURCE_REMOVE;
}

void PushListener::settle() {
  if (const auto settled = std::exchange(_settled, nullptr)) settled();
}

}  // namespace zelqo
