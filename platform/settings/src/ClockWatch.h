/// Notices that somebody set the clock.
#pragma once

#include <glib.h>

#include <functional>

class ClockWatch {
 public:
  /// `onSet` runs on the default main context and may delete the watch.
  explicit ClockWatch(std::function<void()> onSet);
  ~ClockWatch();
  ClockWatch(const ClockWatch&) = delete;
  ClockWatch& operator=(const ClockWatch&) = delete;

 private:
  static gboolean readableCb(int fd, GIOCondition condition, void* data);
  bool arm();
  void readable();

  std::function<void()> _onSet;
  int _timer;
  unsigned _source = 0;
};
