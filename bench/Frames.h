#pragma once

#include <vector>

/// The moments at which the screen changed, and what they say about smoothness.
class Frames {
 public:
  static constexpr double kLateMs = 33.4;  ///< more than two frames of a 60 Hz screen

  /// Several rectangles of one frame arrive within a moment and count once.
  void add(double atMs);
  /// What comes next is not measured against what was before.
  void pause() { _paused = true; }

  int count() const { return static_cast<int>(_gaps.size()); }
  double perSecond() const;
  double longest() const;
  int late() const;

 private:
  double _last = 0;
  bool _paused = true;
  std::vector<double> _gaps;
};
