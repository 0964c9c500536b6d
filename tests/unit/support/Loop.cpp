#include "Loop.h"

#include <Ecore.h>

namespace {

#ifdef __SANITIZE_ADDRESS__
constexpr double kPatience = 120.0;  // everything takes longer there
#else
constexpr double kPatience = 30.0;
#endif

}  // namespace

bool waitUntil(const std::function<bool()>& condition) {
  const double deadline = ecore_time_get() + kPatience;
  // The tick only wakes the loop up, so that the condition is looked at again.
  Ecore_Timer* tick = ecore_timer_add(
      0.01, [](void*) -> Eina_Bool { return ECORE_CALLBACK_RENEW; }, nullptr);
  bool isTrue = condition();
  while (!isTrue && ecore_time_get() < deadline) {
    ecore_main_loop_iterate_may_block(1);
    isTrue = condition();
  }
  ecore_timer_del(tick);
  return isTrue;
}
