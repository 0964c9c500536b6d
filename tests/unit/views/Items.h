#pragma once

#include <Eina.h>
#include <glib.h>

#include <memory>
#include <string>
#include <vector>

#include "ZQVThumbItem.h"

/// A share's files for a test, owned by it.
class Items {
 public:
  ~Items() { eina_list_free(_list); }
  Items() = default;
  Items(const Items&) = delete;
  Items& operator=(const Items&) = delete;

  ZQViewerThumbnailItem& add(const std::string& name, uint32_t size) {
    auto item = std::make_unique<ZQViewerThumbnailItem>();
    item->fileName = g_strdup(name.c_str());
    item->fileSize = size;
    item->mimeType = g_strdup("application/pdf");
    item->downloadUrl = g_strdup_printf("http://service/share/t/file/%u", eina_list_count(_list));
    item->index = static_cast<int32_t>(eina_list_count(_list));
    _list = eina_list_append(_list, item.get());
    _items.push_back(std::move(item));
    return *_items.back();
  }
  void addCount(int count) {
    for (int i = 0; i < count; ++i) add("file" + std::to_string(i) + ".pdf", 100);
  }
  /// An entry without a file.
  void addNothing() { _list = eina_list_append(_list, nullptr); }

  Eina_List* list() const { return _list; }
  size_t size() const { return _items.size(); }
  ZQViewerThumbnailItem& operator[](size_t i) const { return *_items[i]; }

 private:
  Eina_List* _list = nullptr;
  std::vector<std::unique_ptr<ZQViewerThumbnailItem>> _items;
};

inline void replaceText(char** field, const char* text) {
  g_free(*field);
  *field = g_strdup(text);
}
