#include "ZQVIcons.h"

#include <glib.h>

#include <cstring>

#include "ZQVLog.h"

namespace {

struct KindRule {
  const char* mimeType;
  bool part;  ///< the type only has to contain the text
  const char* kind;
  const char* name;
};

/// The first rule that fits decides.
constexpr KindRule kRules[] = {
    {"application/vnd.openxmlformats-officedocument.presentationml.presentation", false, "ppt",
     "presentation"},
    {"application/vnd.ms-powerpoint", false, "ppt", "presentation"},
    {"application/vnd.ms-excel", false, "xls", "spreadsheet"},
    {"application/vnd.openxmlformats-officedocument.spreadsheetml.sheet", false, "xls",
     "spreadsheet"},
    {"text/plain", false, "text", "text"},
    {"image/", true, "img", "image"},
    {"video/", true, "img", "video"},
    {"application/msword", false, "word", "document"},
    {"application/vnd.openxmlformats-officedocument.wordprocessingml.document", false, "word",
     "document"},
    {"application/pdf", false, "pdf", "PDF"},
    {"text/html", false, "html", "web page"},
    {"text/vcard", false, "vcf", "contact"},
    {"text/x-vcard", false, "vcf", "contact"},
    {"application/x-hwp", false, "hwp", "document"},
    {"text/calendar", false, "date", "calendar"},
    {"application/vnd.android.package-archive", false, "etc", "application"},
    {"application/zip", false, "zip", "archive"},
};
constexpr KindRule kAudio = {"audio/", true, "music", "audio"};
constexpr KindRule kUnknown = {"", false, "unknown", "file"};

bool fits(const KindRule& rule, const char* mimeType) {
  return rule.part ? strstr(mimeType, rule.mimeType) != nullptr
                   : strcmp(mimeType, rule.mimeType) == 0;
}

const KindRule& ruleOf(const char* mimeType) {
  for (const KindRule& rule : kRules) {
    if (fits(rule, mimeType)) return rule;
  }
  return kUnknown;
}

char* pathOf(const KindRule& rule, bool small) {
  return g_strconcat(ZQV_FILE_ICON_DIR, small ? "80x80/zq_file_ic_" : "148x148/zq_file_full_ic_",
                     rule.kind, ".png", nullptr);
}

}  // namespace

char* ZQVIcons::getIconPath(const char* mimeType, bool small) {
  return pathOf(ruleOf(mimeType), small);
}

char* ZQVIcons::_getOthersIconPath(const char* mimeType, bool small) {
  if (!mimeType) {
    ZQV_ERROR("type is NULL");
    return nullptr;
  }
  if (fits(kAudio, mimeType)) return pathOf(kAudio, small);
  return getIconPath(mimeType, small);
}

const char* ZQVIcons::getKindName(const char* mimeType) {
  if (!mimeType) return kUnknown.name;
  return fits(kAudio, mimeType) ? kAudio.name : ruleOf(mimeType).name;
}
