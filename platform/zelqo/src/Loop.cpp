#include "Loop.h"

#include <utility>

namespace zelqo {
namespace {

SourceOwner attach(GSource* source, GSourceFunc callback, gpointer data) {
  g_source_set_priority(source, G_PRIORITY_DEFAULT);
  g_source_set_callback(source, callback, data, nullptr);
  g_source_attach(source, g_main_context_get_thread_default());
  return SourceOwner(source);
}

gboolean runCb(gpointer task) {
  (*static_cast<std::function<void()>*>(task))();
  return G_SOURCE_REMOVE;
}

void endTask(gpointer task) {
  delete static_cast<std::function<void()>*>(task);
}

}  // namespace

void EndSource::operator()(GSource* source) const {
  g_source_destroy(source);
  g_source_unref(source);
}

SourceOwner callSoon(GSourceFunc callback, gpointer data) {
  return attach(g_idle_source_new(), callback, data);
}

SourceOwner callAfter(guint ms, GSourceFunc callback, gpointer data) {
  return attach(g_timeout_source_new(ms), callback, data);
}

void runIn(GMainContext* context, std::function<void()> task) {
  GSource* source = g_idle_source_new();
  g_source_set_priority(source, G_PRIORITY_DEFAULT);
  g_source_set_callback(source, runCb, new std::function<void()>(std::move(task)), endTask);
  g_source_attach(source, context);
  g_source_unref(source);
}

}  // namespace zelqo
