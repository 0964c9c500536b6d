#pragma once

#include <app_assist.h>

#include "ZQVCommon.h"
#include "ZQVOwned.h"

/// The pictures that stand for people without one.
#define ZQV_DEFAULT_CALLER_IMAGE ZQV_IMAGE_DIR "contacts_caller_id_default_02.png"
#define ZQV_GROUP_CALLER_IMAGE ZQV_IMAGE_DIR "zq_caller_id_default_group.png"

/// A row with one line of text and a person's picture in front of it.
class WGenlistItemMonoline1Icon : public app_assist::WGenlistItem {
 public:
  /// `text` as for WGenlistItemMonoline. `imagePath` null or empty is the default picture.
  WGenlistItemMonoline1Icon(const char* text, const char* imagePath);
  ~WGenlistItemMonoline1Icon() override;

  Elm_Genlist_Item_Class* getItemClass() override;

  void setText(const char* text);
  void setImage(const char* imagePath);

 private:
  static char* _textCb(void* data, Evas_Object* list, const char* part);
  static Evas_Object* _contentCb(void* data, Evas_Object* list, const char* part);
  static void _deleteCb(void* data, Evas_Object* list);
  Evas_Object* _createImage(Evas_Object* parent) const;

  ZQVOwnedText _text;
  ZQVOwnedText _imagePath;
};
