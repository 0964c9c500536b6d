#pragma once

#include <Eina.h>
#include <media_content.h>
#include <stdint.h>

#include <memory>
#include <string>

#include "ZQVOwned.h"

class ZQViewerThumbnailItem;

/// Files on this phone as items.
class ZQVLocalList {
 public:
  using Media = ZQVOwned<std::remove_pointer_t<media_info_h>, media_info_destroy>;

  /// Appends one item per path to `items` and its size to `totalSize`. `paths` may hold nulls. What
  /// is no file with a name, an extension and a size is left out, with a log line.
  static void append(const char* const* paths, int count, Eina_List** items, uint64_t* totalSize);

  /// What the media database knows of a file; -1 on failure, empty when it knows nothing.
  static int _mediaInfoCreateByPath(const char* path, Media* media);
  /// In bytes; -1 for a null path.
  static long long _getFileSize(const char* path);
  /// The last component that is not empty.
  static std::string _getFilenameFromFilepath(const char* path);

 private:
  static std::unique_ptr<ZQViewerThumbnailItem> _createItem(const char* path, int number);
  static void _getThumbnailByFilePath(const char* path, ZQViewerThumbnailItem* item);
};
