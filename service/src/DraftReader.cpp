#include "DraftReader.h"

#include <algorithm>

#include <common/Json.h>
#include "Address.h"

namespace service {
namespace {

constexpr std::size_t kMaxRecipients = 100;
constexpr guint kMaxFiles = 10000;
constexpr std::size_t kMaxName = 4096;
constexpr std::size_t kMaxType = 255;
constexpr std::size_t kMaxAddress = 8192;
constexpr std::int64_t kDefaultLifetimeS = std::int64_t{14} * 24 * 3600;
constexpr std::int64_t kMaxLifetimeS = std::int64_t{90} * 24 * 3600;

bool fits(const std::optional<std::string>& text, std::size_t limit) {
  return !text || text->size() <= limit;
}

bool isComplete(const ShareFile& file) {
  return file.name && !file.name->empty() && file.size && file.type && !file.type->empty();
}

bool isWithinLimits(const ShareFile& file) {
  return fits(file.name, kMaxName) && fits(file.type, kMaxType) && fits(file.url, kMaxAddress) &&
         fits(file.thumb, kMaxAddress) && fits(file.mid, kMaxAddress) &&
         fits(file.big, kMaxAddress) &&
         (!file.size || (*file.size >= 0 && *file.size <= kMaxFileSize));
}

ShareFile readFile(JsonObject* json, bool lenient) {
  ShareFile file;
  file.name = common::textMember(json, "name");
  file.size = common::numberMember(json, "size");
  file.type = common::textMember(json, "type");
  if (lenient) {
    file.url = common::textMember(json, "url");
    file.thumb = common::textMember(json, "thumb");
    file.mid = common::textMember(json, "mid");
    file.big = common::textMember(json, "big");
  }
  return file;
}

const char* readRecipients(JsonArray* array, ShareDraft& draft) {
  const guint count = array ? json_array_get_length(array) : 0;
  if (count < 1 || count > kMaxRecipients) return "to: 1 to 100 numbers";
  for (guint i = 0; i < count; i++) {
    JsonNode* node = json_array_get_element(array, i);
    const char* text = JSON_NODE_HOLDS_VALUE(node) ? json_node_get_string(node) : nullptr;
    if (!text || !isMsisdn(text)) return "to: numbers in international form";
    if (std::find(draft.recipients.begin(), draft.recipients.end(), text) ==
        draft.recipients.end()) {
      draft.recipients.emplace_back(text);
    }
  }
  return nullptr;
}

const char* readFiles(JsonArray* array, ShareDraft& draft) {
  const guint count = array ? json_array_get_length(array) : 0;
  if (count > kMaxFiles || (count == 0 && !draft.lenient)) return "files: 1 to 10000";
  draft.files.reserve(count);
  for (guint i = 0; i < count; i++) {
    JsonNode* node = json_array_get_element(array, i);
    if (!JSON_NODE_HOLDS_OBJECT(node)) return "files: objects";
    draft.files.push_back(readFile(json_node_get_object(node), draft.lenient));
    if (!isWithinLimits(draft.files.back())) return "files: text too long or size out of range";
    if (!draft.lenient && !isComplete(draft.files.back())) return "files: name, size and type";
  }
  return nullptr;
}

}  // namespace

const char* readDraft(JsonObject* json, ShareDraft& draft) {
  draft.single = common::flagMember(json, "single");
  draft.lenient = common::flagMember(json, "lenient");
  draft.lifetimeS = common::numberMember(json, "expires_in_s").value_or(kDefaultLifetimeS);
  if (draft.lifetimeS < 1 || draft.lifetimeS > kMaxLifetimeS) return "expires_in_s: up to 90 days";
  if (const char* reason = readRecipients(common::arrayMember(json, "to"), draft)) return reason;
  return readFiles(common::arrayMember(json, "files"), draft);
}

}  // namespace service
