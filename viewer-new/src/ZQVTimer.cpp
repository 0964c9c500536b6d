#include "ZQVTimer.h"

#include <utility>

void ZQVTimer::start(double seconds, Tick tick) {
  stop();
  _tick = std::move(tick);
  _timer = ecore_timer_add(seconds, _tickCb, this);
}

void ZQVTimer::stop() {
  if (_timer) {
    ecore_timer_del(_timer);
    _timer = nullptr;
  }
}

Eina_Bool ZQVTimer::_tickCb(void* data) {
  auto* self = static_cast<ZQVTimer*>(data);
  Ecore_Timer* running = self->_timer;
  // The tick may start this timer anew or destroy it with its owner, so it runs from a copy, and a
  // one-shot counts as stopped while it runs.
  Tick tick = self->_tick;
  if (tick()) return ECORE_CALLBACK_RENEW;
  if (self->_timer == running) self->_timer = nullptr;
  return ECORE_CALLBACK_CANCEL;
}
