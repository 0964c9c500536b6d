#pragma once

#include <cstdint>
#include <optional>

namespace downloads {

/// How fast bytes come in, and from that how long the rest takes. Times are seconds of any clock
/// that only goes forward.
class ProgressMeter {
 public:
  /// `received` counts from anywhere; a smaller count than before starts the measurement anew.
  void sample(std::uint64_t received, double now);
  void reset();

  /// Nothing until the speed is known.
  std::optional<double> secondsFor(std::uint64_t remaining) const;

 private:
  bool _hasSample = false;
  std::uint64_t _received = 0;
  double _time = 0;
  double _bytesPerSecond = 0;
};

}  // namespace downloads
