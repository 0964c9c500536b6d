#pragma once

#include <Elementary.h>

class ZQViewerThumbnailItem;

/// The cell of a file in the full view's pager.
class ZQVFullCell {
 public:
  /// The pager's data of that name is the file that it opens with.
  static constexpr const char* kOpening = "opening";

  /// Where the picture of a file lies, whatever is in it; null when there is none.
  static const char* pathOf(const ZQViewerThumbnailItem& item);

  /// The content of one part of the cell; null for parts that have none.
  static Evas_Object* __getFullViewContent(const ZQViewerThumbnailItem* item, Evas_Object* grid,
                                           const char* part);
};
