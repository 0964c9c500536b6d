#include "FakeLog.h"

#include <dlog.h>

#include <algorithm>
#include <cstdarg>
#include <cstdio>
#include <regex>

FakeLog& FakeLog::get() {
  static FakeLog log;
  return log;
}

void FakeLog::add(int priority, const std::string& line) {
  static const std::regex format(
      "([^:]+): ([^(]+)\\((\\d+)\\) > \033\\[0;3[12]m(\\* Critical \\* )?([\\s\\S]*)\033\\[0;m");
  std::smatch match;
  if (std::regex_match(line, match, format)) {
    _lines.push_back({priority == DLOG_ERROR, match[1], match[2], match[5]});
  } else {
    _lines.push_back({priority == DLOG_ERROR, "", "", "malformed line: " + line});
  }
}

std::vector<std::string> FakeLog::errors() const {
  std::vector<std::string> messages;
  for (const LogLine& line : _lines) {
    if (line.isError) messages.push_back(line.message);
  }
  return messages;
}

std::vector<std::string> FakeLog::traces() const {
  std::vector<std::string> messages;
  for (const LogLine& line : _lines) {
    if (!line.isError) messages.push_back(line.message);
  }
  return messages;
}

std::string FakeLog::functionOf(const std::string& message) const {
  for (const LogLine& line : _lines) {
    if (line.message == message) return line.function;
  }
  return "";
}

int FakeLog::count(const std::string& message) const {
  return static_cast<int>(std::count_if(
      _lines.begin(), _lines.end(), [&](const LogLine& line) { return line.message == message; }));
}

extern "C" int dlog_print(log_priority priority, const char*, const char* format, ...) {
  char line[8192];
  va_list values;
  va_start(values, format);
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wformat-nonliteral"
  // NOLINTNEXTLINE(clang-analyzer-valist.Uninitialized): va_start is not seen as one
  const int length = vsnprintf(line, sizeof line, format, values);
#pragma GCC diagnostic pop
  va_end(values);
  FakeLog::get().add(priority, line);
  return length;
}
