/// Phones that wait to be told something.
#pragma once

#include <libsoup/soup.h>

#include <cstdint>
#include <list>
#include <string>

#include "Catalog.h"
#include "HttpAnswer.h"

namespace service {

class PushHub {
 public:
  /// `publicUrl`: where the read side is to be reached, empty when it is this service.
  PushHub(Catalog& catalog, std::string publicUrl)
      : _catalog(catalog), _publicUrl(std::move(publicUrl)) {}

  /// Answers at once when there are events after `after`, else within `waitS` seconds. True when
  /// the answer is there on return.
  bool poll(SoupServerMessage* message, const std::string& msisdn, std::int64_t after, guint waitS);
  /// There may be something new for this number.
  void wake(const std::string& msisdn);

 private:
  struct Waiter {
    Waiter(SoupServerMessage* message, std::string number, std::int64_t cursor)
        : request(message), msisdn(std::move(number)), after(cursor) {}
    HeldRequest request;
    std::string msisdn;
    std::int64_t after;
  };

  bool answerEvents(SoupServerMessage* message, const std::string& msisdn, std::int64_t after);
  void forgetGone();

  Catalog& _catalog;
  std::string _publicUrl;
  std::list<Waiter> _waiters;
};

}  // namespace service
