#include "ZQVTimer.h"

#include <utility>

ZQVTimer::~ZQVTimer() {
  stop();
  if (_gone) *_gone = true;
}

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
  bool gone = false;
  self->_gone = &gone;
  // The tick may start this timer anew or destroy it with its owner, so it runs from a copy.
  const Tick tick = self->_tick;
  const bool again = tick();
  if (gone) return ECORE_CALLBACK_CANCEL;
  self->_gone = nullptr;
  if (!again && self->_timer == running) self->_timer = nullptr;
  return again;
}
