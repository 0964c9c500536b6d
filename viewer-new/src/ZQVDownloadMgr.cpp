#include "ZQVDownloadMgr.h"

#include <app_control.h>

#include "ZQVCommon.h"
#include "ZQVLog.h"
#include "ZQVOrlantLog.h"
#include "ZQVOwned.h"
#include "ZQVThumbItem.h"

namespace {

constexpr const char* kDownloadApp = "com.orlant.myfile-download-manager";

/// What one launch carries, one entry per file in each list.
struct FileLists {
  std::vector<const char*> urls;
  std::vector<const char*> names;
  std::vector<ZQVOwnedText> sizeTexts;
  std::vector<const char*> sizes;
};

FileLists listFiles(const std::vector<ZQViewerThumbnailItem*>& items) {
  FileLists lists;
  for (const ZQViewerThumbnailItem* item : items) {
    lists.urls.push_back(item->downloadUrl ? item->downloadUrl : "");
    lists.names.push_back(item->fileName ? item->fileName : "");
    lists.sizeTexts.emplace_back(g_strdup_printf("%u", item->fileSize));
    lists.sizes.push_back(lists.sizeTexts.back().get());
  }
  return lists;
}

/// The extension of each file. A name without a known one repeats its predecessor's; `owned` keeps
/// the texts.
std::vector<const char*> listExtensions(const std::vector<ZQViewerThumbnailItem*>& items,
                                        std::vector<ZQVOwnedText>* owned) {
  static char invalid[] = "invalid";
  std::vector<const char*> extensions;
  char* extension = invalid;
  for (const ZQViewerThumbnailItem* item : items) {
    char* const previous = extension;
    ZQViewerCommon::getInstance().getFileTypeNum(item->fileName, &extension, 0);
    if (extension != previous) owned->emplace_back(extension);
    extensions.push_back(extension);
  }
  return extensions;
}

void downloadReplyCb(app_control_h, app_control_h reply, app_control_result_e result, void*) {
  if (result == APP_CONTROL_RESULT_SUCCEEDED) return;
  ZQVPlatformText message;
  app_control_get_extra_data(reply, "errorMessage", message.out());
}

void addArray(app_control_h request, const char* key, std::vector<const char*>& values) {
  app_control_add_extra_data_array(request, key, values.data(), static_cast<int>(values.size()));
}

void _launchDownloadApp(FileLists& files, const char* token, const char* sender, bool isWifiOnly) {
  ZQVOwnedAppControl request;
  if (app_control_create(request.out()) != APP_CONTROL_ERROR_NONE) return;
  if (app_control_set_app_id(request.get(), kDownloadApp) != APP_CONTROL_ERROR_NONE) return;
  if (app_control_set_operation(request.get(), APP_CONTROL_OPERATION_VIEW) !=
      APP_CONTROL_ERROR_NONE) {
    return;
  }
  app_control_add_extra_data(request.get(), "remoteShare", "download");
  addArray(request.get(), "url", files.urls);
  addArray(request.get(), "name", files.names);
  addArray(request.get(), "size", files.sizes);
  app_control_add_extra_data(request.get(), "token", token);
  app_control_add_extra_data(request.get(), "sender", sender);
  // The platform refuses empty texts, hence the blank.
  app_control_add_extra_data(request.get(), "sender_icon", " ");
  app_control_add_extra_data(request.get(), "all_downloaded", "0");
  app_control_add_extra_data(request.get(), "wifi_check", isWifiOnly ? "1" : "0");
  app_control_send_launch_request(request.get(), downloadReplyCb, nullptr);
}

}  // namespace

ZQVDownloadMgr::ZQVDownloadMgr(Eina_List* items, bool isWifiOnly, int32_t caller,
                               const char* sender, const char* token)
    : _items(items),
      _isWifiOnly(isWifiOnly),
      _caller(caller),
      _sender(sender ? sender : ""),
      _token(token ? token : "") {}

ZQVDownloadMgr::~ZQVDownloadMgr() = default;

void ZQVDownloadMgr::_downloadMgrCreate() {
  const Items taken = _takeChecked();
  if (taken.empty()) {
    ZQV_ERROR("selected count error");
    return;
  }
  FileLists files = listFiles(taken);
  std::vector<ZQVOwnedText> extensionTexts;
  const std::vector<const char*> extensions = listExtensions(taken, &extensionTexts);
  _launchDownloadApp(files, _token.c_str(), _sender.c_str(), _isWifiOnly);
  _record(taken, extensions);
}

ZQVDownloadMgr::Items ZQVDownloadMgr::_takeChecked() {
  Items taken;
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (!item || !item->checked) continue;
    item->downloadStatus = ZQV_REQUESTED;
    _totalSize += item->fileSize;
    taken.push_back(item);
  }
  return taken;
}

void ZQVDownloadMgr::_record(const Items& taken, const std::vector<const char*>& extensions) const {
  ZQVOrlantLog& log = ZQVOrlantLog::getInstance();
  if (_caller == ZQV_FROM_FULL_VIEW) {
    log.insertFullDownloadContentstype(taken.back()->fileName);
    log.insertFullDownloadSize(taken.back()->fileSize);
    return;
  }
  log.insertSelectDownloadContentstype(extensions.data(), static_cast<int>(extensions.size()));
  log.insertSelectDownloadSize(static_cast<uint32_t>(_totalSize));
}
