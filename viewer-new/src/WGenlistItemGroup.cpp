#include "WGenlistItemGroup.h"

#include "ZQVRows.h"

Elm_Genlist_Item_Class* WGenlistItemGroup::getItemClass() {
  static Elm_Genlist_Item_Class rowClass = zqvRowClass("group_index", _textCb, nullptr);
  return &rowClass;
}

const char* WGenlistItemGroup::getClassName() {
  return "WGenlistItemGroup";
}

void* WGenlistItemGroup::onWrap(void* content) {
  return content;
}
