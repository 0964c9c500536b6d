#include "ZQVLocalList.h"

#include <Ecore_File.h>
#include <mime_type.h>

#include <algorithm>
#include <cstring>
#include <vector>

#include "ZQVCellParts.h"
#include "ZQVIcons.h"
#include "ZQVLog.h"
#include "ZQVThumbItem.h"

namespace {

using Filter = ZQVOwned<std::remove_pointer_t<filter_h>, media_filter_destroy>;
using MediaList = std::vector<ZQVLocalList::Media>;

constexpr size_t kNameBuffer = 512;

/// A connection to the media database; disconnects at the end of its scope.
class MediaConnection {
 public:
  MediaConnection() : _open(media_content_connect() == MEDIA_CONTENT_ERROR_NONE) {
    if (!_open) ZQV_ERROR("connection is failed\n\n");
  }
  ~MediaConnection() {
    if (_open && media_content_disconnect() != MEDIA_CONTENT_ERROR_NONE) {
      ZQV_ERROR("disconnection is failed\n\n");
    }
  }
  MediaConnection(const MediaConnection&) = delete;
  MediaConnection& operator=(const MediaConnection&) = delete;
  bool isOpen() const { return _open; }

 private:
  bool _open;
};

/// The filter's condition for exactly this path; a quote in it is doubled.
std::string conditionFor(const char* path) {
  std::string quoted;
  for (const char* at = path; *at; ++at) quoted.append(*at == '\'' ? 2 : 1, *at);
  return "MEDIA_PATH = '" + quoted + "'";
}

bool keepMediaCb(media_info_h media, void* data) {
  ZQVLocalList::Media clone;
  media_info_clone(clone.out(), media);
  if (clone) static_cast<MediaList*>(data)->push_back(std::move(clone));
  return true;
}

char* mimeTypeOf(const char* extension) {
  ZQVPlatformText type;
  mime_type_get_mime_type(extension, type.out());
  const bool known = type && strcmp(type.get(), "application/octet-stream") != 0;
  return g_strdup(known ? type.get() : "unknown");
}

/// The media database's small picture of a file; null when there is none.
ZQVPlatformText mediaThumbnailOf(const char* path) {
  ZQVPlatformText thumbnail;
  ZQVLocalList::Media media;
  if (ZQVLocalList::_mediaInfoCreateByPath(path, &media) != 0) {
    ZQV_ERROR("_mediaInfoCreateByPath is failed");
    return thumbnail;
  }
  if (!media) return thumbnail;
  const int result = media_info_get_thumbnail_path(media.get(), thumbnail.out());
  if (result != MEDIA_CONTENT_ERROR_NONE) {
    ZQV_ERROR("media_info_get_thumbnail_path failed: %d", result);
  }
  if (thumbnail && !*thumbnail) thumbnail.reset();
  return thumbnail;
}

void setPictures(ZQViewerThumbnailItem* item, const char* small, const char* large) {
  item->thumbPath = g_strdup(small);
  item->largePath = g_strdup(large);
}

}  // namespace

void ZQVLocalList::append(const char* const* paths, int count, Eina_List** items,
                          uint64_t* totalSize) {
  for (int number = 0; number < count; ++number) {
    const char* path = paths[number];
    if (!path) {
      ZQV_ERROR("arrayValue[%d] is NULL", number);
      continue;
    }
    auto item = _createItem(path, number);
    if (!item) continue;
    if (ecore_file_exists(path)) *totalSize += item->fileSize;
    const std::string name = _getFilenameFromFilepath(path);
    if (name.empty()) {
      ZQV_ERROR("service error! fileName is NULL!");
      continue;
    }
    item->fileName = g_strdup(name.c_str());
    item->filePath = g_strdup(path);
    // NOLINTNEXTLINE(clang-analyzer-cplusplus.NewDeleteLeaks): the list owns its items
    *items = eina_list_append(*items, item.release());
  }
}

std::unique_ptr<ZQViewerThumbnailItem> ZQVLocalList::_createItem(const char* path, int number) {
  const char* dot = strrchr(path, '.');
  if (!dot) {
    ZQV_ERROR("name[%d] is NULL", number);
    return nullptr;
  }
  auto item = std::make_unique<ZQViewerThumbnailItem>();
  item->index = number;
  item->mimeType = mimeTypeOf(dot + 1);
  _getThumbnailByFilePath(path, item.get());
  item->fileSize = static_cast<uint32_t>(_getFileSize(path));
  if (item->fileSize == 0) {
    ZQV_ERROR("service error! fileSize is 0!");
    return nullptr;
  }
  return item;
}

void ZQVLocalList::_getThumbnailByFilePath(const char* path, ZQViewerThumbnailItem* item) {
  const ZQVPlatformText thumbnail = mediaThumbnailOf(path);
  const bool exists = ecore_file_exists(path);
  item->noThumbnail = !exists;
  if (zqvContains(item->mimeType, "image/")) {
    const char* picture = thumbnail ? thumbnail.get() : path;
    setPictures(item, exists ? picture : ZQV_SMALL_IMG_ICON, exists ? picture : ZQV_LARGE_IMG_ICON);
    item->thumbUrl = g_strdup(item->thumbPath);
  } else if (zqvContains(item->mimeType, "video/")) {
    const bool hasPicture = exists && thumbnail;
    setPictures(item, hasPicture ? thumbnail.get() : ZQV_SMALL_IMG_ICON,
                hasPicture ? thumbnail.get() : ZQV_LARGE_IMG_ICON);
    item->thumbUrl = g_strdup(path);
  } else {
    item->thumbPath = ZQVIcons::_getOthersIconPath(item->mimeType, true);
    item->largePath = ZQVIcons::_getOthersIconPath(item->mimeType, false);
  }
}

int ZQVLocalList::_mediaInfoCreateByPath(const char* path, Media* media) {
  const MediaConnection connection;
  if (!connection.isOpen()) return -1;
  Filter filter;
  int result = media_filter_create(filter.out());
  if (result != MEDIA_CONTENT_ERROR_NONE) {
    ZQV_ERROR("Fail to create filter: %d", result);
    return -1;
  }
  result = media_filter_set_condition(filter.get(), conditionFor(path).c_str(),
                                      MEDIA_CONTENT_COLLATE_NOCASE);
  if (result != MEDIA_CONTENT_ERROR_NONE) {
    ZQV_ERROR("Fail to set condition: %d", result);
    return -1;
  }
  MediaList found;
  result = media_info_foreach_media_from_db(filter.get(), keepMediaCb, &found);
  if (result != MEDIA_CONTENT_ERROR_NONE) {
    ZQV_ERROR("media_info_foreach_media_from_db failed: %d", result);
    return -1;
  }
  filter.reset();
  if (found.empty()) {
    ZQV_ERROR("all_item_list is NULL");
  } else {
    *media = std::move(found.front());
  }
  return 0;
}

long long ZQVLocalList::_getFileSize(const char* path) {
  if (!path) {
    ZQV_ERROR("path is NULL");
    return -1;
  }
  return ecore_file_size(path);
}

std::string ZQVLocalList::_getFilenameFromFilepath(const char* path) {
  if (!path) {
    ZQV_ERROR("file_path is NULL");
    return {};
  }
  const char* end = path + strlen(path);
  while (end > path && end[-1] == '/') --end;
  const char* start = end;
  while (start > path && start[-1] != '/') --start;
  return std::string(start, std::min(static_cast<size_t>(end - start), kNameBuffer - 1));
}
