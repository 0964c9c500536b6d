/// The toolkit's own threads, fewer than it would start. Each takes turns with the main thread at
/// locks that spin, and a phone has few processors to spin on.
#pragma once

namespace app_assist {

/// Before the toolkit starts.
void paintInMainThread();
/// After its start.
void limitDecodingThreads();

}  // namespace app_assist
