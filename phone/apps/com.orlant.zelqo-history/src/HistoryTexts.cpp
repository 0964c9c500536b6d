#include "HistoryTexts.h"

#include <common/Owned.h>
#include <companion/Text.h>

using companion::format;
using companion::text;

namespace history {
namespace {

std::string dateText(std::int64_t ms) {
  GDateTime* time = g_date_time_new_from_unix_local(ms / 1000);
  if (!time) return {};
  const common::OwnedText date(g_date_time_format(time, "%x"));
  g_date_time_unref(time);
  return date ? date.get() : "";
}

std::string filesText(const zelqo::ShareSummary& share) {
  if (share.fileCount != 1 || share.firstFile.empty()) {
    return companion::filesText(static_cast<int>(share.fileCount));
  }
  const common::OwnedText name(g_path_get_basename(share.firstFile.c_str()));
  return name.get();
}

std::string stateText(const zelqo::ShareSummary& share, std::int64_t nowMs) {
  if (share.recalledMs) return text("Recalled by the sender");
  if (share.expiresMs / 1000 < nowMs / 1000) {
    return format("Expired on %s", dateText(share.expiresMs).c_str());
  }
  const std::string date = dateText(share.createdMs);
  return share.received ? format("Received on %s", date.c_str())
                        : format("Sent on %s", date.c_str());
}

}  // namespace

bool isShown(const zelqo::ShareSummary& share) {
  return share.received || !share.recalledMs;
}

bool isGone(const zelqo::ShareSummary& share, std::int64_t nowMs) {
  return share.received && (share.recalledMs || share.expiresMs / 1000 < nowMs / 1000);
}

std::string detailOf(const zelqo::ShareSummary& share, std::int64_t nowMs) {
  return filesText(share) + " · " + stateText(share, nowMs);
}

}  // namespace history
