#include "efl_assist.h"

#include <Edje.h>

#include <base/Fault.h>
#include <cstring>

#include "Appearance.h"
#include "MaskedPicture.h"

Eina_Bool ea_theme_color_get(const char* code, int* r, int* g, int* b, int* a, int* r2, int* g2,
                             int* b2, int* a2, int* r3, int* g3, int* b3, int* a3) {
  if (base::strikes(__func__)) return EINA_FALSE;
  if (!code) return EINA_FALSE;
  return edje_color_class_get(code, r, g, b, a, r2, g2, b2, a2, r3, g3, b3, a3);
}

Eina_Bool ea_theme_font_get(const char* code, char** font, int* size) {
  if (base::strikes(__func__)) return EINA_FALSE;
  const char* name = nullptr;
  int pixels = 0;
  if (!code || !font || !size || !edje_text_class_get(code, &name, &pixels) || !name) {
    return EINA_FALSE;
  }
  *font = strdup(name);
  *size = pixels;
  return EINA_TRUE;
}

Eina_Bool ea_theme_object_color_set(Evas_Object* obj, const char* code) {
  if (base::strikes(__func__)) return EINA_FALSE;
  return obj && code && theme::Appearance::instance().colourObject(obj, code);
}

void* ea_image_effect_mask(const char* image, const char* mask, int w, int h, int mask_x,
                           int mask_y) {
  if (base::strikes(__func__)) return nullptr;
  return theme::maskedPicture(image, mask, {w, h}, mask_x, mask_y);
}
