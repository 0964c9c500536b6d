#include "Repetition.h"

#include <utility>

namespace dlog {

bool Repetition::isOneTooMany(const Line& line, gint64 timeUs) {
  if (_written < kWritten || !continues(line, timeUs)) return false;
  _counted++;
  return true;
}

Repetition::Line Repetition::takeCount() {
  const unsigned count = std::exchange(_counted, 0);
  if (count == 0) return {};
  return {_row.priority, _row.tag, "the line before, repeated: " + std::to_string(count)};
}

void Repetition::written(const Line& line, gint64 timeUs) {
  if (!continues(line, timeUs)) {
    _row = line;
    _since = timeUs;
    _written = 0;
  }
  _written++;
}

}  // namespace dlog
