#include "GlibBridge.h"

#include <Ecore.h>
#include <glib.h>
#include <poll.h>
#include <sys/select.h>

#include <cerrno>
#include <vector>

namespace app_assist {
namespace {

using PollList = std::vector<GPollFD>;

/// What GLib waits for; `waitMs` is how long it can wait, -1 for ever.
PollList glibSide(GMainContext* context, int priority, int* waitMs) {
  PollList list(16);
  int count;
  while ((count = g_main_context_query(context, priority, waitMs, list.data(),
                                       static_cast<int>(list.size()))) >
         static_cast<int>(list.size())) {
    list.resize(count);
  }
  list.resize(count);
  return list;
}

void appendToolkitSide(PollList& list, int count, const fd_set* readable, const fd_set* writable,
                       const fd_set* urgent) {
  for (int fd = 0; fd < count; fd++) {
    const gushort events = (FD_ISSET(fd, readable) ? G_IO_IN : 0) |
                           (FD_ISSET(fd, writable) ? G_IO_OUT : 0) |
                           (FD_ISSET(fd, urgent) ? G_IO_PRI : 0);
    if (events) list.push_back({fd, events, 0});
  }
}

int reportToToolkit(const PollList& list, size_t first, fd_set* readable, fd_set* writable,
                    fd_set* urgent) {
  FD_ZERO(readable);
  FD_ZERO(writable);
  FD_ZERO(urgent);
  int ready = 0;
  for (size_t i = first; i < list.size(); i++) {
    const GPollFD& entry = list[i];
    if (!entry.revents) continue;
    ready++;
    if (entry.revents & (G_IO_IN | G_IO_HUP | G_IO_ERR)) FD_SET(entry.fd, readable);
    if (entry.revents & G_IO_OUT) FD_SET(entry.fd, writable);
    if (entry.revents & G_IO_PRI) FD_SET(entry.fd, urgent);
  }
  return ready;
}

/// The shorter of both waits; null when both wait for ever.
const timespec* shorterWait(const timeval* toolkit, int glibMs, timespec* result) {
  if (toolkit) *result = {toolkit->tv_sec, toolkit->tv_usec * 1000};
  if (glibMs < 0) return toolkit ? result : nullptr;
  const timespec glib{glibMs / 1000, glibMs % 1000 * 1000000L};
  const bool glibFirst = !toolkit || glib.tv_sec < result->tv_sec ||
                         (glib.tv_sec == result->tv_sec && glib.tv_nsec < result->tv_nsec);
  if (glibFirst) *result = glib;
  return result;
}

/// Stands in for select() in the toolkit's loop. What GLib has ready is dispatched from here, on
/// the main thread; a dispatched callback may run a nested loop and so come here again.
int selectBoth(int count, fd_set* readable, fd_set* writable, fd_set* urgent, timeval* timeout) {
  GMainContext* context = g_main_context_default();
  if (!g_main_context_acquire(context)) return select(count, readable, writable, urgent, timeout);
  int priority = 0;
  g_main_context_prepare(context, &priority);
  int glibMs = -1;
  PollList list = glibSide(context, priority, &glibMs);
  const size_t glibCount = list.size();
  appendToolkitSide(list, count, readable, writable, urgent);

  timespec wait;
  static_assert(sizeof(GPollFD) == sizeof(pollfd), "GLib's record is the system's");
  const int result = ppoll(reinterpret_cast<pollfd*>(list.data()), list.size(),
                           shorterWait(timeout, glibMs, &wait), nullptr);
  const int failure = errno;
  if (result < 0) {
    for (GPollFD& entry : list) entry.revents = 0;
  }
  if (g_main_context_check(context, priority, list.data(), static_cast<int>(glibCount)))
    g_main_context_dispatch(context);
  g_main_context_release(context);
  if (result < 0) {
    errno = failure;
    return -1;
  }
  return reportToToolkit(list, glibCount, readable, writable, urgent);
}

}  // namespace

void installGlibBridge() {
  ecore_main_loop_select_func_set(selectBoth);
}

}  // namespace app_assist
