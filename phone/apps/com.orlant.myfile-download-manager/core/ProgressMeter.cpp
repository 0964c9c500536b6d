#include "ProgressMeter.h"

namespace downloads {
namespace {

constexpr double kMinInterval = 0.2;  // seconds; shorter ones measure chance
constexpr double kNewWeight = 0.3;    // of the newest interval in the running average

}  // namespace

void ProgressMeter::sample(std::uint64_t received, double now) {
  if (!_hasSample || received < _received) {
    reset();
    _hasSample = true;
    _received = received;
    _time = now;
    return;
  }
  const double seconds = now - _time;
  if (seconds < kMinInterval) return;
  const double speed = static_cast<double>(received - _received) / seconds;
  _bytesPerSecond =
      _bytesPerSecond == 0 ? speed : kNewWeight * speed + (1 - kNewWeight) * _bytesPerSecond;
  _received = received;
  _time = now;
}

void ProgressMeter::reset() {
  *this = ProgressMeter();
}

std::optional<double> ProgressMeter::secondsFor(std::uint64_t remaining) const {
  if (_bytesPerSecond <= 0) return {};
  return static_cast<double>(remaining) / _bytesPerSecond;
}

}  // namespace downloads
