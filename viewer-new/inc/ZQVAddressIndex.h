#pragma once

#include <Eina.h>

#include <string_view>
#include <unordered_map>

class ZQViewerThumbnailItem;

/// Finds a share's files by their download address: anybody may send download signals, as many as
/// they like, and a share may have thousands of files.
class ZQVAddressIndex {
 public:
  /// The first file with that address, null when there is none. The files are read with the first
  /// question; the list and the addresses in it stay as they are from then on.
  ZQViewerThumbnailItem* find(const Eina_List* items, const char* address);

 private:
  void _read(const Eina_List* items);

  bool _isRead = false;
  std::unordered_map<std::string_view, ZQViewerThumbnailItem*> _files;
};
