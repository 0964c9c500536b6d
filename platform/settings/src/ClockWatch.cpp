#include "ClockWatch.h"

#include <dlog.h>
#include <glib-unix.h>
#include <sys/timerfd.h>
#include <unistd.h>

#include <cerrno>
#include <cstdint>
#include <cstring>
#include <limits>

ClockWatch::ClockWatch(std::function<void()> onSet)
    : _onSet(std::move(onSet)), _timer(timerfd_create(CLOCK_REALTIME, TFD_NONBLOCK | TFD_CLOEXEC)) {
  if (arm()) {
    _source = g_unix_fd_add(_timer, G_IO_IN, readableCb, this);
  } else {
    dlog_print(DLOG_WARN, "SETTINGS", "clock changes go unnoticed: %s", strerror(errno));
  }
}

ClockWatch::~ClockWatch() {
  if (_source) g_source_remove(_source);
  if (_timer >= 0) close(_timer);
}

/// A time that never comes: only a clock that is set makes the timer speak.
bool ClockWatch::arm() {
  itimerspec never{};
  never.it_value.tv_sec = std::numeric_limits<decltype(never.it_value.tv_sec)>::max();
  return _timer >= 0 &&
         timerfd_settime(_timer, TFD_TIMER_ABSTIME | TFD_TIMER_CANCEL_ON_SET, &never, nullptr) == 0;
}

gboolean ClockWatch::readableCb(int, GIOCondition, void* data) {
  static_cast<ClockWatch*>(data)->readable();
  return G_SOURCE_CONTINUE;
}

void ClockWatch::readable() {
  uint64_t expirations = 0;
  const bool set = read(_timer, &expirations, sizeof expirations) < 0 && errno == ECANCELED;
  arm();
  if (!set) return;
  const auto onSet = _onSet;
  onSet();
}
