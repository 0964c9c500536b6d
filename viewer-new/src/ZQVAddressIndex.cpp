#include "ZQVAddressIndex.h"

#include "ZQVThumbItem.h"

ZQViewerThumbnailItem* ZQVAddressIndex::find(const Eina_List* items, const char* address) {
  if (!_isRead) _read(items);
  const auto found = _files.find(address);
  return found == _files.end() ? nullptr : found->second;
}

void ZQVAddressIndex::_read(const Eina_List* items) {
  _isRead = true;
  _files.reserve(eina_list_count(items));
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    // The first file with an address keeps it.
    if (item && item->downloadUrl) _files.emplace(item->downloadUrl, item);
  }
}
