#include <dlog.h>

#include "LogLine.h"
#include "Repetition.h"

#include <glib.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <memory>
#include <mutex>

namespace {

using dlog::Repetition;

constexpr size_t kJournalLimit = 4096;

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

int writeLine(const Repetition::Line& line) {
  static const bool journal = g_log_writer_is_journald(STDERR_FILENO);
  const std::string text = dlog::logLine(letter(line.priority), line.tag, getpid(), line.message);
  return journal && toJournal(line.priority, line.tag.c_str(),
                              dlog::oneLine(line.message, kJournalLimit).c_str())
             ? static_cast<int>(text.size())
             : toStderr(text);
}

/// What all threads of the process have said last. It outlives whatever might log at its end.
struct Log {
  std::mutex mutex;
  Repetition repetition;
};

Log& theLog() {
  static Log& log = *new Log;
  return log;
}

/// Whoever calls has the lock.
void writeCount() {
  const Repetition::Line count = theLog().repetition.takeCount();
  if (count.priority != DLOG_UNKNOWN) writeLine(count);
}

int say(const Repetition::Line& line) {
  static const int atEnd = atexit([] {
    const std::lock_guard<std::mutex> lock(theLog().mutex);
    writeCount();
  });
  static_cast<void>(atEnd);
  const std::lock_guard<std::mutex> lock(theLog().mutex);
  const gint64 now = g_get_monotonic_time();
  Repetition& repetition = theLog().repetition;
  if (repetition.isOneTooMany(line, now)) return static_cast<int>(line.message.size());
  writeCount();
  repetition.written(line, now);
  return writeLine(line);
}

}  // namespace

int dlog_vprint(log_priority prio, const char* tag, const char* fmt, va_list ap) {
  if (!writable(prio) || !tag || !fmt) return DLOG_ERROR_INVALID_PARAMETER;
  if (prio == DLOG_SILENT) return 0;
  const int savedErrno = errno;  // callers log between a failed call and their look at errno
  std::unique_ptr<char, decltype(&g_free)> message(g_strdup_vprintf(fmt, ap), g_free);
  if (!message) return DLOG_ERROR_INVALID_PARAMETER;
  const int written = say({prio, tag, message.get()});
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
