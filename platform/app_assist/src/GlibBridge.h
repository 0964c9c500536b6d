/// Lets GLib's sources (GDBus, timeouts, idles) run under the toolkit's main loop.
#pragma once

namespace app_assist {

/// Once, after elm_init. The toolkit of a desktop is built without GLib; this waits for both sides
/// in one poll(), so neither polls nor starves the other.
void installGlibBridge();

}  // namespace app_assist
