#include "Frames.h"

#include <algorithm>
#include <numeric>

namespace {

constexpr double kSameFrameMs = 4;

}  // namespace

void Frames::add(double atMs) {
  if (!_paused && atMs - _last < kSameFrameMs) return;
  if (!_paused) _gaps.push_back(atMs - _last);
  _paused = false;
  _last = atMs;
}

double Frames::perSecond() const {
  const double sum = std::accumulate(_gaps.begin(), _gaps.end(), 0.0);
  return sum > 0 ? count() * 1e3 / sum : 0;
}

double Frames::longest() const {
  return _gaps.empty() ? 0 : *std::max_element(_gaps.begin(), _gaps.end());
}

int Frames::late() const {
  return static_cast<int>(
      std::count_if(_gaps.begin(), _gaps.end(), [](double gap) { return gap > kLateMs; }));
}
