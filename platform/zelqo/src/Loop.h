/// Work for main loops, which may be those of other threads.
#pragma once

#include <glib.h>

#include <functional>
#include <memory>

namespace zelqo {

struct EndSource {
  void operator()(GSource* source) const;
};
using SourceOwner = std::unique_ptr<GSource, EndSource>;

/// Calls from the main loop of the calling thread, for as long as the callback and the owner want.
SourceOwner callSoon(GSourceFunc callback, gpointer data);
SourceOwner callAfter(guint ms, GSourceFunc callback, gpointer data);

/// Any thread's way into the main loop of a context, in order; null is the application's.
void runIn(GMainContext* context, std::function<void()> task);

}  // namespace zelqo
