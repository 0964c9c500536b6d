#include "ZQVCellParts.h"

#include <efl_assist.h>

#include <cstring>

#include "ZQVCommon.h"
#include "ZQVLog.h"
#include "ZQVText.h"

bool zqvContains(const char* text, const char* part) {
  return text && strstr(text, part);
}

Evas_Object* zqvCreateLabel(Evas_Object* parent, const char* markup) {
  if (!parent) {
    ZQV_ERROR("!parent");
    return nullptr;
  }
  Evas_Object* label = elm_label_add(parent);
  elm_label_line_wrap_set(label, ELM_WRAP_NONE);
  elm_label_wrap_width_set(label, 1);
  elm_label_ellipsis_set(label, EINA_TRUE);
  evas_object_size_hint_weight_set(label, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  evas_object_size_hint_align_set(label, EVAS_HINT_FILL, EVAS_HINT_FILL);
  elm_object_domain_translatable_text_set(label, ZQV_TEXT_DOMAIN, markup);
  evas_object_show(label);
  return label;
}

Evas_Object* zqvAddColouredIcon(Evas_Object* owner, Evas_Object* layout, const char* part,
                                const char* path, const char* colour) {
  Evas_Object* icon = ZQViewerCommon::getInstance().createIcon(owner, path);
  ea_theme_object_color_set(icon, colour);
  elm_object_part_content_set(layout, part, icon);
  return icon;
}
