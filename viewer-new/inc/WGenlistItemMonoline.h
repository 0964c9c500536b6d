#pragma once

#include <app_assist.h>

#include "ZQVOwned.h"

/// A row with one line of text.
class WGenlistItemMonoline : public app_assist::WGenlistItem {
 public:
  /// `text` is a message id, or markup that stands as it is; null leaves the row empty.
  explicit WGenlistItemMonoline(const char* text);
  ~WGenlistItemMonoline() override;

  Elm_Genlist_Item_Class* getItemClass() override;
  virtual const char* getClassName();
  /// For derived rows that wrap what they are given; returns its argument.
  virtual void* onWrap(void* content);

  void setText(const char* text);

 protected:
  static char* _textCb(void* data, Evas_Object* list, const char* part);

 private:
  ZQVOwnedText _text;
};
