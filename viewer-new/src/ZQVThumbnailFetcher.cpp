#include "ZQVThumbnailFetcher.h"

#include <Ecore_File.h>
#include <Elementary.h>
#include <app_preference.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>

#include "ZQVAccess.h"
#include "ZQVCellParts.h"
#include "ZQVCommon.h"
#include "ZQVDownloadedFile.h"
#include "ZQVIcons.h"
#include "ZQVLog.h"
#include "ZQVSharedFiles.h"
#include "ZQVThumbItem.h"

namespace {

constexpr const char* kNormalFolder = "/opt/usr/apps/com.orlant.zelqo/shared/data/thumbnail";
constexpr const char* kMidFolder = "/opt/usr/apps/com.orlant.zelqo/shared/data/fullview_thumbnail";
constexpr const char* kComplete = "downloaded";

constexpr double kWatchdogTime = 40.0;
constexpr double kRefreshDelay = 0.8;
constexpr int kNormalPriority = 1;
constexpr size_t kPathBuffer = 512;

/// Null when nothing is stored under the key.
ZQVPlatformText preferenceOf(const char* key) {
  ZQVPlatformText value;
  if (preference_get_string(key, value.out()) != PREFERENCE_ERROR_NONE) value.reset();
  return value;
}

void replaceText(char** text, const char* value) {
  g_free(*text);
  *text = g_strdup(value);
}

bool isDownloaded(const ZQViewerThumbnailItem* item) {
  if (!item->downloadUrl) return false;
  const ZQVOwnedText recorded = ZQVThumbnailFetcher::_getItemFromJson(item->downloadUrl);
  if (!recorded) return zqvIsDownloadedByName(*item);
  char path[kPathBuffer] = {};
  g_strlcpy(path, recorded.get(), sizeof path);
  return ecore_file_exists(path);
}

/// Draws the grid anew in which the item is a cell then, if it still is.
void refreshLater(ZQVTimer* timer, const ZQViewerThumbnailItem* item, ZQVViewType viewType) {
  if (!item->gridItems[viewType]) return;
  timer->start(kRefreshDelay, [item, viewType] {
    Elm_Object_Item* cell = item->gridItems[viewType];
    if (cell) elm_gengrid_realized_items_update(elm_object_item_widget_get(cell));
    return false;
  });
}

}  // namespace

void ZQVThumbnailFetcher::setShare(Eina_List* items, const char* contentsToken) {
  forgetShare();
  _items = items;
  _contentsToken = contentsToken ? contentsToken : "";
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    _serviceIndices.push_back(static_cast<ZQViewerThumbnailItem*>(data)->index);
  }
}

void ZQVThumbnailFetcher::forgetShare() {
  _items = nullptr;
  _serviceIndices.clear();
  _gridRefresh.stop();
  _fullViewRefresh.stop();
}

void ZQVThumbnailFetcher::stopWatchdogs() {
  _midThumbTimer.stop();
  _normalThumbTimer.stop();
}

void ZQVThumbnailFetcher::_getContentInfoNReqNormalThumbnail(zelqo_share_h handle) {
  if (!handle) {
    ZQV_ERROR("handle is NULL");
    return;
  }
  Urls missing;
  int position = 0;
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    _readContentInfo(handle, _serviceIndices[static_cast<size_t>(position)], item);
    _reuseThumbnail(item, &missing);
    item->index = position++;
  }
  if (_isMarkedComplete() || missing.empty()) return;
  if (!_checkAndCreateFolder(kNormalFolder)) {
    ZQV_ERROR("thumbnail_path didnot exist and create failed: %s", kNormalFolder);
    return;
  }
  ZQV_TRACE("Going to downloading normal thumbnail");
  _normalThumbTimer.start(kWatchdogTime, [this] { return _clearNormalThumbnailTimerCb(this); });
  _request(missing, kNormalFolder);
}

void ZQVThumbnailFetcher::_readContentInfo(zelqo_share_h handle, int serviceIndex,
                                           ZQViewerThumbnailItem* item) {
  ZQVPlatformText url;
  const int result = zelqo_content_info_get_download_url(
      handle, static_cast<unsigned int>(serviceIndex), url.out());
  replaceText(&item->downloadUrl, result == ZELQO_ERROR_NONE ? url.get() : nullptr);
  const ZQVOwnedText icon(ZQVIcons::_getOthersIconPath(item->mimeType, true));
  if (icon) replaceText(&item->thumbPath, icon.get());
  if (!isDownloaded(item)) return;
  item->downloadStatus = ZQV_DOWNLOADED;
  // The cell got its name before.
  zqvSetAccessibleName(item->gridItems[ZQV_VIEW_RECEIVER], zqvCellName(*item));
}

void ZQVThumbnailFetcher::_reuseThumbnail(ZQViewerThumbnailItem* item, Urls* missing) {
  if (!item->thumbUrl) return;
  const ZQVPlatformText stored = preferenceOf(item->thumbUrl);
  if (stored && ecore_file_exists(stored.get())) {
    replaceText(&item->thumbPath, stored.get());
    return;
  }
  missing->push_back(item->thumbUrl);
  if (stored) preference_remove(item->thumbUrl);
}

void ZQVThumbnailFetcher::_reqMidThumbnail(zelqo_share_h handle) {
  if (!handle) {
    ZQV_ERROR("handle is NULL");
    return;
  }
  Urls missing;
  size_t position = 0;
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    ZQVPlatformText type;
    const auto number = static_cast<unsigned int>(_serviceIndices[position++]);
    if (zelqo_content_info_get_content_type(handle, number, type.out()) != ZELQO_ERROR_NONE) {
      ZQV_ERROR("zelqo_content_info_get_content_type");
      return;
    }
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    const ZQVOwnedText icon(ZQVIcons::_getOthersIconPath(type.get(), false));
    if (icon) replaceText(&item->largePath, icon.get());
    _reuseMidThumbnail(item, &missing);
  }
  if (missing.empty()) return;
  if (!_checkAndCreateFolder(kMidFolder)) {
    ZQV_ERROR("failed to create [%s]", kMidFolder);
    return;
  }
  ZQV_TRACE("Going to downloading mid thumbnail");
  _midThumbTimer.start(kWatchdogTime, [this] { return _clearMidThumbnailTimerCb(this); });
  _request(missing, kMidFolder);
}

void ZQVThumbnailFetcher::_reuseMidThumbnail(ZQViewerThumbnailItem* item, Urls* missing) {
  if (!item->midThumbUrl) return;
  const ZQVPlatformText stored = preferenceOf(item->midThumbUrl);
  if (!stored) {
    missing->push_back(item->midThumbUrl);
  } else if (*stored) {
    replaceText(&item->largePath, stored.get());
  }
}

void ZQVThumbnailFetcher::_request(Urls& urls, const char* folder) {
  const int result = zelqo_request_download(urls.data(), static_cast<unsigned int>(urls.size()),
                                            folder, kNormalPriority, 0, _SAPIDownloadCb, this);
  if (result != ZELQO_ERROR_NONE) ZQV_ERROR("zelqo_request_download");
}

bool ZQVThumbnailFetcher::_isMarkedComplete() const {
  return g_strcmp0(preferenceOf(_contentsToken.c_str()).get(), kComplete) == 0;
}

int ZQVThumbnailFetcher::_SAPIDownloadCb(unsigned int, int, const char* downloadPath,
                                         const char* thumbUrl, unsigned int, void* app) {
  if (!app) {
    ZQV_ERROR("!user_data");
  } else if (!thumbUrl) {
    ZQV_ERROR("!thumb_url");
  } else if (!downloadPath) {
    ZQV_ERROR("!download_path");
  } else {
    static_cast<ZQVThumbnailFetcher*>(app)->_arrived(downloadPath, thumbUrl);
  }
  return 0;
}

void ZQVThumbnailFetcher::_arrived(const char* path, const char* url) {
  const bool mid = zqvContains(path, kMidFolder);
  // One arrival proves that the service works on this batch.
  (mid ? _midThumbTimer : _normalThumbTimer).stop();
  ZQViewerThumbnailItem* item = _find(url, mid);
  if (!item) return;
  replaceText(mid ? &item->largePath : &item->thumbPath, path);
  bool stored = false;
  preference_is_existing(url, &stored);
  if (!stored) preference_set_string(url, path);
  if (mid) {
    refreshLater(&_fullViewRefresh, item, ZQV_VIEW_FULL_RECEIVER);
  } else {
    _normalArrived(item, path);
  }
}

void ZQVThumbnailFetcher::_normalArrived(ZQViewerThumbnailItem* item, const char* path) {
  refreshLater(&_gridRefresh, item, ZQV_VIEW_RECEIVER);
  if (g_strcmp0(item->largePath, ZQV_LARGE_IMG_ICON) == 0) {
    // Better than an icon until the mid-size picture arrives.
    replaceText(&item->largePath, path);
    refreshLater(&_fullViewRefresh, item, ZQV_VIEW_FULL_RECEIVER);
  }
  ZQV_TRACE("111");
  if (eina_list_last_data_get(_items) == item) {
    preference_set_string(_contentsToken.c_str(), kComplete);
  }
}

ZQViewerThumbnailItem* ZQVThumbnailFetcher::_find(const char* url, bool mid) const {
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (g_strcmp0(mid ? item->midThumbUrl : item->thumbUrl, url) == 0) return item;
  }
  return nullptr;
}

bool ZQVThumbnailFetcher::_clearNormalThumbnailTimerCb(ZQVThumbnailFetcher* app) {
  if (!app) {
    ZQV_ERROR("!data");
    return false;
  }
  ZQV_ERROR("service error orrured, more than 40sec still not download thumbnail.");
  return false;
}

bool ZQVThumbnailFetcher::_clearMidThumbnailTimerCb(ZQVThumbnailFetcher* app) {
  if (!app) {
    ZQV_ERROR("!data");
    return false;
  }
  ZQV_ERROR("service error orrured, more than 40sec still not download mid-thumbnail.");
  return false;
}

bool ZQVThumbnailFetcher::_checkAndCreateFolder(const char* path) {
  if (!path) {
    ZQV_ERROR("folder path is NULL");
    return false;
  }
  if (!ecore_file_exists(path) && !ecore_file_mkdir(path)) {
    ZQV_ERROR("create %s failed. errno: %s", path, strerror(errno));
    return false;
  }
  if (!ecore_file_can_write(path) && chmod(path, 0777) != 0) {
    ZQV_ERROR("chmod %s failed. errno: %s", path, strerror(errno));
    return false;
  }
  return true;
}

ZQVOwnedText ZQVThumbnailFetcher::_getItemFromJson(const char* url) {
  return ZQVSharedFiles::getInstance().pathOf(url);
}
