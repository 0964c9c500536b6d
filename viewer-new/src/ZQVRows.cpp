#include "ZQVRows.h"

#include <glib.h>

#include <cstring>

#include "ZQVText.h"

extern "C" {
/// Only the headers of the device's toolkit declare this.
void elm_genlist_realization_mode_set(Evas_Object* list, Eina_Bool mode);
}

namespace {

void deleteRowCb(void* data, Evas_Object*) {
  delete static_cast<app_assist::WGenlistItem*>(data);
}

}  // namespace

Elm_Genlist_Item_Class zqvRowClass(const char* style, Elm_Gen_Item_Text_Get_Cb text,
                                   Elm_Gen_Item_Content_Get_Cb content) {
  Elm_Genlist_Item_Class rowClass{};
  rowClass.item_style = style;
  rowClass.func.text_get = text;
  rowClass.func.content_get = content;
  rowClass.func.del = deleteRowCb;
  return rowClass;
}

Evas_Object* zqvCreateRowList(Evas_Object* parent) {
  Evas_Object* list = elm_genlist_add(parent);
  elm_genlist_mode_set(list, ELM_LIST_COMPRESS);
  elm_genlist_realization_mode_set(list, EINA_TRUE);
  evas_object_show(list);
  return list;
}

bool zqvIsOneOf(const char* part, std::initializer_list<const char*> parts) {
  for (const char* candidate : parts) {
    if (g_strcmp0(part, candidate) == 0) return true;
  }
  return false;
}

char* zqvRowText(const char* id) {
  return id ? strdup(zqvText(id)) : nullptr;
}

Elm_Object_Item* zqvAppendRow(Evas_Object* list, app_assist::WGenlistItem* row,
                              Evas_Smart_Cb selected, void* data) {
  Elm_Object_Item* item = elm_genlist_item_append(list, row->getItemClass(), row, nullptr,
                                                  ELM_GENLIST_ITEM_NONE, selected, data);
  if (item) {
    row->setElmObjectItem(item);
  } else {
    delete row;
  }
  return item;
}
