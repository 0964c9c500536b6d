/// Who says the same thing over and over fills the log of everybody else: of equal lines in a row,
/// a few a second are written, and then how many more there were.
#pragma once

#include <dlog.h>
#include <glib.h>

#include <string>

namespace dlog {

class Repetition {
 public:
  static constexpr unsigned kWritten = 16;
  static constexpr gint64 kWindowUs = G_USEC_PER_SEC;

  struct Line {
    log_priority priority = DLOG_UNKNOWN;
    std::string tag;
    std::string message;
    bool operator==(const Line& other) const {
      return priority == other.priority && message == other.message && tag == other.tag;
    }
  };

  /// Whether the line continues a row that is long enough, and is only counted.
  bool isOneTooMany(const Line& line, gint64 timeUs);
  /// The line that says how many were only counted and begins to count anew; of no priority when
  /// there were none. To be asked for before any other line is written.
  Line takeCount();
  /// Begins a row with the line, or goes on with one.
  void written(const Line& line, gint64 timeUs);

 private:
  bool continues(const Line& line, gint64 timeUs) const {
    return timeUs - _since < kWindowUs && line == _row;
  }

  Line _row;
  gint64 _since = 0;
  unsigned _written = 0;
  unsigned _counted = 0;
};

}  // namespace dlog
