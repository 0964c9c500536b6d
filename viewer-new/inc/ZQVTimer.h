#pragma once

#include <Ecore.h>

#include <functional>

/// A timer as a member: starting again replaces, destroying cancels.
class ZQVTimer {
 public:
  /// True keeps the timer running, false ends it.
  using Tick = std::function<bool()>;

  ZQVTimer() = default;
  ~ZQVTimer();
  ZQVTimer(const ZQVTimer&) = delete;
  ZQVTimer& operator=(const ZQVTimer&) = delete;

  void start(double seconds, Tick tick);
  void stop();
  bool isRunning() const { return _timer != nullptr; }

 private:
  static Eina_Bool _tickCb(void* data);

  Ecore_Timer* _timer = nullptr;
  Tick _tick;
  bool* _gone = nullptr;  ///< told when this timer is destroyed by its own tick
};
