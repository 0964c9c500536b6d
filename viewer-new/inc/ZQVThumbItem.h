#pragma once

#include <app_assist.h>
#include <stdint.h>

/// Values of downloadStatus.
enum ZQVDownloadStatus : int32_t {
  ZQV_NOT_DOWNLOADED = 0,
  ZQV_REQUESTED = 1,
  ZQV_DOWNLOADING = 2,
  ZQV_DOWNLOADED = 3,
};

/// Values of a grid's "ViewType" object data, and indices of gridItems.
enum ZQVViewType : int32_t {
  ZQV_VIEW_NONE = 0,
  ZQV_VIEW_RECEIVER = 1,
  ZQV_VIEW_SELECT = 2,
  ZQV_VIEW_SENDER = 3,
  ZQV_VIEW_FULL_RECEIVER = 4,
  ZQV_VIEW_FULL_SENDER = 5,
  ZQV_VIEW_COUNT = 6,
};

/// One shared file, which is at the same time its cell in every grid. Texts are heap strings owned
/// by the item and released with g_free.
class ZQViewerThumbnailItem : public app_assist::WGengridItem {
 public:
  ZQViewerThumbnailItem();
  ~ZQViewerThumbnailItem() override;

  Elm_Gengrid_Item_Class* getItemClass() override;

  /// Stores the check state and shows it in the select grid's cell.
  void setCheckStatus(bool checked);

  char* thumbPath;         ///< local path of the small picture or its icon
  char* largePath;         ///< local path of the large picture or its icon
  char* thumbUrl;          ///< address of the thumbnail; a local file's own path; null for none
  char* midThumbUrl;       ///< address of the mid-size (or big) thumbnail; null for none
  char* downloadUrl;       ///< the file's download address: its identity
  bool checked;            ///< ticked in the select view
  bool noThumbnail;        ///< a local file that does not exist
  int32_t downloadStatus;  ///< a ZQVDownloadStatus
  char* fileName;          ///< as the sender called it: never markup, never a path
  uint32_t fileSize;       ///< bytes
  char* mimeType;
  int32_t index;  ///< position in the share, -1 until set
  /// The item's cell in each kind of grid, by ZQVViewType; null while it is in none.
  Elm_Object_Item* gridItems[ZQV_VIEW_COUNT];
  char* filePath;  ///< local file only: its full path
};
