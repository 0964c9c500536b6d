#pragma once

/// The clock of all ZQVTimers of a test: it stands still until a test moves it.
class FakeClock {
 public:
  /// Runs what falls due, in order.
  static void advance(double seconds);
  /// How many timers are running.
  static int running();
};
