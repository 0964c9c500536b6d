#pragma once

#include <Eina.h>
#include <stdint.h>
#include <zelqo.h>

class ZQViewerThumbnailItem;

/// The files of a received share as items.
class ZQVReceivedList {
 public:
  /// Appends one item per file to `items`, in share order, its `index` being the file's number at
  /// the service. Files without name, size or type are left out; returns how many that were.
  static uint32_t append(zelqo_share_h share, uint32_t fileCount, Eina_List** items);

 private:
  static void _readPictureUrls(zelqo_share_h share, uint32_t number, ZQViewerThumbnailItem* item);
  static bool _readFile(zelqo_share_h share, uint32_t number, ZQViewerThumbnailItem* item);
};
