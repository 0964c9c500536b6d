#pragma once

#include <Ecore.h>

#include <functional>

/// Runs the main loop until the condition holds; false when that takes more than ten seconds.
inline bool waitUntil(const std::function<bool()>& condition) {
  struct Wait {
    const std::function<bool()>& condition;
    const double deadline;
    bool met = false;
  } wait{condition, ecore_time_get() + 10};
  if (condition()) return true;
  ecore_timer_add(
      0.002,
      [](void* data) -> Eina_Bool {
        auto* wait = static_cast<Wait*>(data);
        wait->met = wait->condition();
        if (!wait->met && ecore_time_get() < wait->deadline) return ECORE_CALLBACK_RENEW;
        ecore_main_loop_quit();
        return ECORE_CALLBACK_CANCEL;
      },
      &wait);
  ecore_main_loop_begin();
  return wait.met;
}

/// Lets everything happen that is due in the loop pass after the next.
inline void passLoop() {
  int passes = 0;
  waitUntil([&] { return ++passes > 2; });
}
