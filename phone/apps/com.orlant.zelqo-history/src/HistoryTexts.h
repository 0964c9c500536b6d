/// What the history says of a share.
#pragma once

#include <zelqo/Share.h>

#include <cstdint>
#include <string>

namespace history {

/// Sent ones that were recalled are of no more use; received ones stay, as gone.
bool isShown(const zelqo::ShareSummary& share);

/// A received share whose files can no longer be fetched.
bool isGone(const zelqo::ShareSummary& share, std::int64_t nowMs);

std::string detailOf(const zelqo::ShareSummary& share, std::int64_t nowMs);

}  // namespace history
