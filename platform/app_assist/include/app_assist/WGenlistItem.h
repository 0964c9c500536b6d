#pragma once

#include <Elementary.h>

namespace app_assist {

/// The data of one genlist item, which knows its own item class.
class WGenlistItem {
 public:
  WGenlistItem() = default;
  virtual ~WGenlistItem();
  WGenlistItem(const WGenlistItem&) = delete;
  WGenlistItem& operator=(const WGenlistItem&) = delete;

  /// A static of the class, never freed.
  virtual Elm_Genlist_Item_Class* getItemClass() = 0;
  /// The class for new items; by default the one of getItemClass.
  virtual Elm_Genlist_Item_Class* getItemClassNew();
  virtual void onSelect();
  virtual void onSetElmObjectItem(Elm_Object_Item* item);

  /// Remembers the toolkit's item (null when it goes) and calls onSetElmObjectItem.
  void setElmObjectItem(Elm_Object_Item* item);
  Elm_Object_Item* getElmObjectItem() const { return _item; }

 private:
  Elm_Object_Item* _item = nullptr;
};

}  // namespace app_assist
