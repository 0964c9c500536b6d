#pragma once

#include <string>
#include <vector>

/// One line of the platform log, taken apart.
struct LogLine {
  bool isError;
  std::string file;
  std::string function;
  std::string message;
};

/// Stands in front of the platform log and keeps what was logged.
class FakeLog {
 public:
  static FakeLog& get();

  void clear() { _lines.clear(); }
  void add(int priority, const std::string& line);
  const std::vector<LogLine>& lines() const { return _lines; }
  std::vector<std::string> errors() const;
  std::vector<std::string> traces() const;
  /// The function that logged a message; empty when nobody did.
  std::string functionOf(const std::string& message) const;
  int count(const std::string& message) const;

 private:
  std::vector<LogLine> _lines;
};
