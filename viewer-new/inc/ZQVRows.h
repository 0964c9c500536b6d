/// What all rows of genlists have in common.
#pragma once

#include <app_assist.h>

#include <initializer_list>

/// A static item class, which the toolkit neither counts nor frees. Rows of it are deleted with
/// their items.
Elm_Genlist_Item_Class zqvRowClass(const char* style, Elm_Gen_Item_Text_Get_Cb text,
                                   Elm_Gen_Item_Content_Get_Cb content);

/// A list that keeps all its rows realised.
Evas_Object* zqvCreateRowList(Evas_Object* parent);

bool zqvIsOneOf(const char* part, std::initializer_list<const char*> parts);

/// A row's text as the toolkit wants it: translated, new, null for null.
char* zqvRowText(const char* id);

/// Appends a row, which the list owns from then on. Null when the list took no row; the row object
/// is gone then.
Elm_Object_Item* zqvAppendRow(Evas_Object* list, app_assist::WGenlistItem* row,
                              Evas_Smart_Cb selected, void* data);

/// The row object behind the toolkit's data pointer.
template <typename Row>
Row* zqvRowOf(void* data) {
  return static_cast<Row*>(static_cast<app_assist::WGenlistItem*>(data));
}
