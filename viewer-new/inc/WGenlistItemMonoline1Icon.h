#pragma once

#include <app_assist.h>

#include "ZQVOwned.h"

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
  Evas_Object* _createImage(Evas_Object* parent) const;

  ZQVOwnedText _text;
  ZQVOwnedText _imagePath;
};
