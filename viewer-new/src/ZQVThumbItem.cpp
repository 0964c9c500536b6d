#include "ZQVThumbItem.h"

#include <glib.h>

#include "ZQVFullCell.h"
#include "ZQVItemGrid.h"
#include "ZQVLog.h"
#include "ZQVSmallCell.h"

namespace {

Evas_Object* _contentGetCb(void* data, Evas_Object* grid, const char* part) {
  const auto* item = static_cast<ZQViewerThumbnailItem*>(data);
  switch (ZQVItemGrid::viewTypeOf(grid)) {
    case ZQV_VIEW_FULL_RECEIVER:
    case ZQV_VIEW_FULL_SENDER:
      return ZQVFullCell::__getFullViewContent(item, grid, part);
    default:
      return ZQVSmallCell::__getContent(item, grid, part);
  }
}

Elm_Gengrid_Item_Class* createItemClass() {
  Elm_Gengrid_Item_Class* itemClass = elm_gengrid_item_class_new();
  itemClass->item_style = "default";
  itemClass->func.content_get = _contentGetCb;
  return itemClass;
}

}  // namespace

ZQViewerThumbnailItem::ZQViewerThumbnailItem()
    : thumbPath(nullptr),
      largePath(nullptr),
      thumbUrl(nullptr),
      midThumbUrl(nullptr),
      downloadUrl(nullptr),
      checked(false),
      noThumbnail(false),
      downloadStatus(ZQV_NOT_DOWNLOADED),
      fileName(nullptr),
      fileSize(0),
      mimeType(nullptr),
      index(-1),
      gridItems{},
      filePath(nullptr) {}

ZQViewerThumbnailItem::~ZQViewerThumbnailItem() {
  for (char* text :
       {thumbPath, largePath, thumbUrl, midThumbUrl, downloadUrl, fileName, mimeType, filePath}) {
    g_free(text);
  }
}

Elm_Gengrid_Item_Class* ZQViewerThumbnailItem::getItemClass() {
  static Elm_Gengrid_Item_Class* itemClass = createItemClass();
  return itemClass;
}

void ZQViewerThumbnailItem::setCheckStatus(bool status) {
  Elm_Object_Item* cell = gridItems[ZQV_VIEW_SELECT];
  if (!cell) {
    ZQV_ERROR("It is not select mode");
    return;
  }
  Evas_Object* check = elm_object_item_part_content_get(cell, "elm.swallow.end");
  if (!check) {
    ZQV_ERROR("Fail to get check");
    return;
  }
  checked = status;
  elm_object_signal_emit(check, status ? "elm,activate,check,on" : "elm,activate,check,off", "elm");
  elm_check_state_set(check, status);
}
