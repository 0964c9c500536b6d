#include "ZQVNeighbourPictures.h"

#include "ZQVFullCell.h"
#include "ZQVPictureGate.h"
#include "ZQVScreenPicture.h"
#include "ZQVThumbItem.h"

namespace {

void decode(ZQVPicturePreload* preload, Elm_Object_Item* cell) {
  const auto* item =
      cell ? static_cast<ZQViewerThumbnailItem*>(elm_object_item_data_get(cell)) : nullptr;
  const char* path = item ? ZQVFullCell::pathOf(*item) : nullptr;
  Evas_Object* pager = path ? elm_object_item_widget_get(cell) : nullptr;
  const int size = path ? ZQVScreenPicture::sizeOn(pager, path) : 0;
  if (size > 0 && ZQVPictureGate::isLight(path)) {
    preload->start(evas_object_evas_get(pager), path, size, nullptr);
  } else {
    preload->stop();
  }
}

}  // namespace

void ZQVNeighbourPictures::lookAround(Elm_Object_Item* cell) {
  decode(&_before, cell ? elm_gengrid_item_prev_get(cell) : nullptr);
  decode(&_after, cell ? elm_gengrid_item_next_get(cell) : nullptr);
}
