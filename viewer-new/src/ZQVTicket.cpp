#include "ZQVTicket.h"

#include <unordered_map>

namespace {

using Holders = std::unordered_map<uintptr_t, void*>;

Holders& holders() {
  static Holders valid;
  return valid;
}

}  // namespace

ZQVTicket::ZQVTicket(void* holder) {
  static uintptr_t last = 0;
  _number = ++last;
  holders()[_number] = holder;
}

void ZQVTicket::withdraw() {
  holders().erase(_number);
}

void* ZQVTicket::holderOf(void* userData) {
  const auto found = holders().find(reinterpret_cast<uintptr_t>(userData));
  return found == holders().end() ? nullptr : found->second;
}
