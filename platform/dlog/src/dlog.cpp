#include <dlog.h>

#include "LogLine.h"

#include <glib.h>
#include <unistd.h>

#include <cerrno>
#include <memory>

namespace {

bool writable(log_priority prio) {
  return prio > DLOG_UNKNOWN && prio < DLOG_PRIO_MAX;
}

char letter(log_priority prio) {
  return "?DVDIWEF?"[prio];
}

/// The journal's priorities are syslog's.
const char* syslogPriority(log_priority prio) {
  switch (prio) {
    case DLOG_INFO:
      return "6";
    case DLOG_WARN:
      return "4";
    case DLOG_ERROR:
      return "3";
    case DLOG_FATAL:
      return "2";
    default:
      return "7";
  }
}

bool toJournal(log_priority prio, const char* tag, const char* message) {
  const GLogField fields[] = {
      {"MESSAGE", message, -1},
      {"PRIORITY", syslogPriority(prio), -1},
      {"SYSLOG_IDENTIFIER", tag, -1},
      {"GLIB_DOMAIN", tag, -1},
  };
  return g_log_writer_journald(G_LOG_LEVEL_MESSAGE, fields, G_N_ELEMENTS(fields), nullptr) ==
         G_LOG_WRITER_HANDLED;
}

int toStderr(const std::string& line) {
  ssize_t written = -1;
  do {
    written = write(STDERR_FILENO, line.data(), line.size());
  } while (written < 0 && errno == EINTR);
  return written < 0 ? -errno : static_cast<int>(written);
}

}  // namespace

int dlog_vprint(log_priority prio, const char* tag, const char* fmt, va_list ap) {
  if (!writable(prio) || !tag || !fmt) return DLOG_ERROR_INVALID_PARAMETER;
  if (prio == DLOG_SILENT) return 0;
  const int savedErrno = errno;  // callers log between a failed call and their look at errno
  std::unique_ptr<char, decltype(&g_free)> message(g_strdup_vprintf(fmt, ap), g_free);
  if (!message) return DLOG_ERROR_INVALID_PARAMETER;
  static const bool journal = g_log_writer_is_journald(STDERR_FILENO);
  const std::string line = dlog::logLine(letter(prio), tag, getpid(), message.get());
  const int written = journal && toJournal(prio, tag, dlog::oneLine(message.get(), 4096).c_str())
                          ? static_cast<int>(line.size())
                          : toStderr(line);
  errno = savedErrno;
  return written;
}

int dlog_print(log_priority prio, const char* tag, const char* fmt, ...) {
  va_list ap;
  va_start(ap, fmt);
  const int written = dlog_vprint(prio, tag, fmt, ap);
  va_end(ap);
  return written;
}
