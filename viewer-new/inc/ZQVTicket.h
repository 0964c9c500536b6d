#pragma once

#include <stdint.h>

/// A number that stands for an object in calls that may be answered late, twice or never: once the
/// object or its ticket is gone, an answer finds nobody.
class ZQVTicket {
 public:
  explicit ZQVTicket(void* holder);
  ~ZQVTicket() { withdraw(); }
  ZQVTicket(const ZQVTicket&) = delete;
  ZQVTicket& operator=(const ZQVTicket&) = delete;

  /// From here on nothing is found any more.
  void withdraw();
  /// What to give along as user data.
  void* asUserData() const { return reinterpret_cast<void*>(_number); }
  /// The holder, or null when it is gone.
  static void* holderOf(void* userData);

 private:
  uintptr_t _number;
};
