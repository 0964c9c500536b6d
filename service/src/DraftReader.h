/// Reads what a sender announces.
#pragma once

#include <json-glib/json-glib.h>

#include "Share.h"

namespace service {

constexpr std::int64_t kMaxFileSize = 0xffffffff;  ///< phones keep sizes in 32 bits

/// Null when `draft` is complete and within the limits, else the reason why not. The sender is not
/// read.
const char* readDraft(JsonObject* json, ShareDraft& draft);

}  // namespace service
