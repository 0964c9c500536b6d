/// The rule that decides whether a download may start, the same on every page.
#pragma once

#include <stdint.h>

/// Up to this many bytes are downloaded without asking.
constexpr int64_t ZQV_LARGEST_UNASKED_DOWNLOAD = 6291456;

/// May files be fetched over the present network? When not, a status-bar message says why.
bool zqvNetworkAllowsDownload(bool isWifiOnly);
