#include "WaitUntil.h"

#include <glib.h>

bool waitUntil(const std::function<bool()>& condition) {
  bool late = false;
  const guint timer = g_timeout_add_seconds(
      20,
      [](gpointer flag) -> gboolean {
        *static_cast<bool*>(flag) = true;
        return G_SOURCE_CONTINUE;
      },
      &late);
  while (!condition() && !late) g_main_context_iteration(nullptr, TRUE);
  g_source_remove(timer);
  return condition();
}

void runPending() {
  while (g_main_context_iteration(nullptr, FALSE)) {
  }
}
