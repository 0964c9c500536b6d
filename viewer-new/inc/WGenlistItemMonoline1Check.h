#pragma once

#include <app_assist.h>

#include "ZQVOwned.h"

/// A row with one line of text and a check at its end. Every tap, on the check too, ends in the
/// row's select handler, which decides about the check.
class WGenlistItemMonoline1Check : public app_assist::WGenlistItem {
 public:
  /// `text` is a message id.
  explicit WGenlistItemMonoline1Check(const char* text);
  ~WGenlistItemMonoline1Check() override;

  Elm_Genlist_Item_Class* getItemClass() override;

  bool isChecked() const { return _checked; }
  /// Shows the state in the row's check, if it is on screen, with the theme's animation.
  void setChecked(bool checked);

  /// The check was toggled: undoes that and selects the row instead.
  static void _checkChangedCb(void* data, Evas_Object* check, void* info);

 private:
  static char* _textCb(void* data, Evas_Object* list, const char* part);
  static Evas_Object* _contentCb(void* data, Evas_Object* list, const char* part);
  Evas_Object* _createCheck(Evas_Object* parent);
  Evas_Object* _findCheck() const;

  ZQVOwnedText _text;
  Eina_Bool _checked = EINA_FALSE;
};
