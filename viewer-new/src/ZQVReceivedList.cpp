#include "ZQVReceivedList.h"

#include <memory>

#include "ZQVIcons.h"
#include "ZQVLog.h"
#include "ZQVOwned.h"
#include "ZQVThumbItem.h"

namespace {

using TextGetter = int (*)(zelqo_share_h, unsigned int, char**);

/// Null when the service has no such text.
char* textOf(TextGetter get, zelqo_share_h share, uint32_t number) {
  ZQVPlatformText text;
  const int result = get(share, number, text.out());
  return result == ZELQO_ERROR_NONE ? g_strdup(text.get()) : nullptr;
}

}  // namespace

uint32_t ZQVReceivedList::append(zelqo_share_h share, uint32_t fileCount, Eina_List** items) {
  uint32_t failures = 0;
  for (uint32_t number = 0; number < fileCount; ++number) {
    auto item = std::make_unique<ZQViewerThumbnailItem>();
    item->index = static_cast<int32_t>(number);
    // Stands until the address is read, together with the thumbnails.
    item->downloadUrl = g_strdup(ZQV_LARGE_IMG_ICON);
    item->thumbPath = g_strdup(ZQV_SMALL_IMG_ICON);
    item->largePath = g_strdup(ZQV_LARGE_IMG_ICON);
    _readPictureUrls(share, number, item.get());
    if (_readFile(share, number, item.get())) {
      *items = eina_list_append(*items, item.release());
    } else {
      ++failures;
    }
  }
  return failures;
}

void ZQVReceivedList::_readPictureUrls(zelqo_share_h share, uint32_t number,
                                       ZQViewerThumbnailItem* item) {
  item->thumbUrl = textOf(zelqo_content_info_get_thumbnail_url, share, number);
  if (!item->thumbUrl) ZQV_ERROR("get thumbnail url[the %uth] failed from SAPI", number);
  item->midThumbUrl = textOf(zelqo_content_info_get_mid_thumbnail_url, share, number);
  if (item->midThumbUrl) return;
  ZQV_ERROR("get mid thumbnail url[the %uth] failed from SAPI", number);
  item->midThumbUrl = textOf(zelqo_content_info_get_big_thumbnail_url, share, number);
  if (!item->midThumbUrl) ZQV_ERROR("get big thumbnail url[the %uth] failed from SAPI", number);
}

bool ZQVReceivedList::_readFile(zelqo_share_h share, uint32_t number, ZQViewerThumbnailItem* item) {
  item->fileName = textOf(zelqo_content_info_get_file_name, share, number);
  if (!item->fileName) {
    ZQV_ERROR("service error! get fileName[the %uth] failed from SAPI!", number);
    return false;
  }
  zelqo_content_info_get_file_size(share, number, &item->fileSize);
  if (item->fileSize == 0) {
    ZQV_ERROR("service error! get fileSize[the %uth] failed from SAPI!", number);
    return false;
  }
  item->mimeType = textOf(zelqo_content_info_get_content_type, share, number);
  if (!item->mimeType) {
    ZQV_ERROR("service error! get fileType[the %uth] failed from SAPI!", number);
    return false;
  }
  return true;
}
