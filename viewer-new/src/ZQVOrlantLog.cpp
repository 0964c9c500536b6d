#include "ZQVOrlantLog.h"

#include <bundle.h>

#include <array>

#include "ZQVCommon.h"
#include "ZQVLog.h"
#include "ZQVOwned.h"

namespace {

constexpr const char* kAppId = "com.orlant.zelqo";
constexpr const char* kFeatureUri = "content://com.orlant.usagelog/log/use_app_feature_survey";

constexpr uint32_t k100MB = 104857600;
constexpr uint32_t k500MB = 524288000;
constexpr uint32_t k1GB = 1073741824;

struct EntryPath {
  const char* caller;
  const char* sent;
  const char* received;
};

constexpr std::array<EntryPath, 3> kEntryPaths{{
    {"com.orlant.message-lite", "Enhanced message_sender", "Enhanced message_receiver"},
    {"com.orlant.zelqo-history", "Shared_history_sent", "Shared_history_received"},
    {"com.orlant.myfile-download-manager", "Download_history", "Download_history"},
}};

const char* entryPathOf(const char* caller, int entry) {
  for (const EntryPath& path : kEntryPaths) {
    if (g_strcmp0(caller, path.caller) == 0) {
      return entry == ZQV_ENTRY_SENT ? path.sent : path.received;
    }
  }
  return "Push_notification";
}

/// Null when a file-type number belongs to no category.
const char* categoryOf(int fileType) {
  if (fileType < 0 || fileType > 79) return nullptr;
  if (fileType <= 24) return "Video";
  if (fileType <= 56) return "Audio";
  if (fileType <= 64) return "Photo";
  if (fileType == 74) return "Memo";
  if (fileType <= 76) return "Document";
  return fileType == 77 ? "Contact" : "Plandex";
}

const char* categoryOfName(const char* fileName) {
  return categoryOf(ZQViewerCommon::getInstance().getFileTypeNum(fileName, nullptr, 0));
}

const char* countBucketOf(int count) {
  if (count < 1 || count > 100) return nullptr;
  if (count <= 10) return "1_10";
  return count <= 50 ? "11_50" : "51_100";
}

const char* sizeBucketOf(uint32_t bytes) {
  if (bytes < k100MB) return "0_100MB";
  if (bytes < k500MB) return "100MB_500MB";
  return bytes <= k1GB ? "500MB_1GB" : nullptr;
}

void ignoreReply(int, int, void*) {}

}  // namespace

ZQVOrlantLog::ZQVOrlantLog() {
  _create();
}

ZQVOrlantLog::~ZQVOrlantLog() {
  if (_handle) orlant_log_manager_destroy(_handle);
}

ZQVOrlantLog& ZQVOrlantLog::getInstance() {
  static bool isFirst = true;
  static ZQVOrlantLog instance;
  if (!isFirst && !instance._handle) instance._create();
  isFirst = false;
  return instance;
}

void ZQVOrlantLog::_create() {
  if (orlant_log_manager_create(&_handle) == ORLANT_LOG_ERROR_NONE) return;
  _handle = nullptr;
  ZQV_ERROR("orlant_log_manager_create failed");
}

void ZQVOrlantLog::insertEntryPath(app_control_h request, int entry) {
  if (!request) {
    ZQV_ERROR("request is NULL");
    return;
  }
  ZQVPlatformText caller;
  app_control_get_caller(request, caller.out());
  _insert("ZQ50", entryPathOf(caller.get(), entry));
}

void ZQVOrlantLog::insertSelectDownloadContentstype(const char* const* extensions, int count) {
  for (int i = 0; i < count; ++i) {
    const int fileType = ZQViewerCommon::getInstance().getFileTypeNum(extensions[i], nullptr, 1);
    const char* category = categoryOf(fileType);
    if (category) _insert("ZQ51", category);
  }
}

void ZQVOrlantLog::insertSelectDownloadCount(int count) {
  const char* bucket = countBucketOf(count);
  if (bucket) _insert("ZQ52", bucket);
}

void ZQVOrlantLog::insertSelectDownloadSize(uint32_t bytes) {
  const char* bucket = sizeBucketOf(bytes);
  if (bucket) _insert("ZQ53", bucket);
}

void ZQVOrlantLog::insertFullDownloadContentstype(const char* fileName) {
  if (!fileName) {
    ZQV_ERROR("file_name is NULL");
    return;
  }
  const char* category = categoryOfName(fileName);
  _insert("ZQ54", category ? category : "");
}

void ZQVOrlantLog::insertFullDownloadSize(uint32_t bytes) {
  const char* bucket = sizeBucketOf(bytes);
  if (bucket) _insert("ZQ55", bucket);
}

void ZQVOrlantLog::insertFullOpenContentstype(const char* fileName) {
  if (!fileName) {
    ZQV_ERROR("file_name is NULL");
    return;
  }
  const char* category = categoryOfName(fileName);
  _insert("ZQ56", category ? category : "");
}

void ZQVOrlantLog::insertRecall() {
  _insert("ZQ57", nullptr);
}

void ZQVOrlantLog::insertReshare() {
  _insert("ZQ58", nullptr);
}

void ZQVOrlantLog::_insert(const char* feature, const char* extra) {
  ZQVOwnedBundle record(bundle_create());
  if (!record) return;
  bundle_add_str(record.get(), "app_id", kAppId);
  bundle_add_str(record.get(), "feature", feature);
  if (extra) bundle_add_str(record.get(), "extra", extra);
  int requestId = 0;
  orlant_log_manager_insert(_handle, kFeatureUri, record.get(), ignoreReply, nullptr, &requestId);
}
