#pragma once

#include <Elementary.h>

class ZQViewerThumbnailItem;

/// The cell of a file in the full view's pager.
class ZQVFullCell {
 public:
  /// The content of one part of the cell; null for parts that have none.
  static Evas_Object* __getFullViewContent(const ZQViewerThumbnailItem* item, Evas_Object* grid,
                                           const char* part);
};
