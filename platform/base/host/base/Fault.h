/// Lets calls of the platform fail on demand, to see what an application makes of it.
#pragma once

namespace base {

/// At the entry of every call that can fail: true when this call has to fail now, with whatever its
/// documentation promises for the worst case. That is the n-th such call of the process when the
/// environment says PLATFORM_FAIL_CALL=n. PLATFORM_COUNT_CALLS=FILE has every call written down
/// there, one name per line.
bool strikes(const char* call);

}  // namespace base
