#include "app_assist/WGengridItem.h"

namespace app_assist {

WGengridItem::~WGengridItem() = default;

Elm_Gengrid_Item_Class* WGengridItem::getItemClassNew() {
  return getItemClass();
}

void WGengridItem::onSelect() {}

void WGengridItem::onSetElmObjectItem(Elm_Object_Item*) {}

void WGengridItem::setElmObjectItem(Elm_Object_Item* item) {
  _item = item;
  onSetElmObjectItem(item);
}

}  // namespace app_assist
