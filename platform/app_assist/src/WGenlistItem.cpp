#include "app_assist/WGenlistItem.h"

namespace app_assist {

WGenlistItem::~WGenlistItem() = default;

Elm_Genlist_Item_Class* WGenlistItem::getItemClassNew() {
  return getItemClass();
}

void WGenlistItem::onSelect() {}

void WGenlistItem::onSetElmObjectItem(Elm_Object_Item*) {}

void WGenlistItem::setElmObjectItem(Elm_Object_Item* item) {
  _item = item;
  onSetElmObjectItem(item);
}

}  // namespace app_assist
