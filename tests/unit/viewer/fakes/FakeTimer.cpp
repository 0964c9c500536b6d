// Stands in for the toolkit's timers behind ZQVTimer, so that no test waits for the time of day.
#include "FakeTimer.h"

#include <functional>
#include <map>
#include <utility>

#include "ZQVTimer.h"

namespace {

struct Entry {
  double due;
  double interval;
  std::function<bool()> tick;
};

double now = 0;
long lastNumber = 0;
std::map<long, Entry>& entries() {
  static std::map<long, Entry> all;
  return all;
}

std::map<long, Entry>::iterator firstDue(double until) {
  auto first = entries().end();
  for (auto at = entries().begin(); at != entries().end(); ++at) {
    if (at->second.due > until + 1e-9) continue;
    if (first == entries().end() || at->second.due < first->second.due) first = at;
  }
  return first;
}

}  // namespace

void FakeClock::advance(double seconds) {
  const double until = now + seconds;
  for (auto next = firstDue(until); next != entries().end(); next = firstDue(until)) {
    const long number = next->first;
    now = next->second.due;
    next->second.due += next->second.interval;
    const auto tick = next->second.tick;
    if (!tick()) entries().erase(number);
  }
  now = until;
}

int FakeClock::running() {
  return static_cast<int>(entries().size());
}

ZQVTimer::~ZQVTimer() {
  (void)_gone;  // only the toolkit's timers need it
  stop();
}

void ZQVTimer::start(double seconds, Tick tick) {
  stop();
  _tick = std::move(tick);
  const long number = ++lastNumber;
  _timer = reinterpret_cast<Ecore_Timer*>(number);
  entries()[number] = {now + seconds, seconds, [this] { return _tickCb(this); }};
}

void ZQVTimer::stop() {
  entries().erase(reinterpret_cast<long>(_timer));
  _timer = nullptr;
}

Eina_Bool ZQVTimer::_tickCb(void* data) {
  auto* self = static_cast<ZQVTimer*>(data);
  Ecore_Timer* running = self->_timer;
  Tick tick = self->_tick;
  if (tick()) return ECORE_CALLBACK_RENEW;
  if (entries().count(reinterpret_cast<long>(running)) && self->_timer == running) {
    self->_timer = nullptr;
  }
  return ECORE_CALLBACK_CANCEL;
}
