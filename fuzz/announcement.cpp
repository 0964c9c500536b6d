// What a sender announces to the sharing service, and the ranges that recipients ask for: a header
// on the first line, JSON below.

#include <common/Json.h>
#include "ByteRange.h"
#include "DraftReader.h"
#include "Require.h"
#include "Texts.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string text(reinterpret_cast<const char*>(data), size);
  const size_t end = std::min(text.find('\n'), text.size());
  const std::string header = text.substr(0, end);
  for (const int64_t length : {int64_t{0}, int64_t{1000}, INT64_MAX}) {
    const auto range = service::parseByteRange(header.c_str(), length);
    if (range.kind != service::ByteRange::Kind::Part) continue;
    require(range.first >= 0 && range.length > 0 && range.first <= length - range.length);
  }
  const auto json =
      common::parseJsonObject(std::string_view(text).substr(end == size ? end : end + 1));
  service::ShareDraft draft;
  if (!json || service::readDraft(json_node_get_object(json.get()), draft)) return 0;
  require(!draft.recipients.empty() && draft.recipients.size() <= 100);
  require(draft.files.size() <= 10000 && draft.lifetimeS >= 1);
  return 0;
}
