#pragma once

namespace app_assist {

/// The toolkit keeps little of what is no longer shown: the phone's memory is for all applications.
/// After the toolkit's start, before the first window.
void limitMemoryUse();

}  // namespace app_assist
