#include "efl_assist.h"

#include <cstring>

#include "CurrentTheme.h"
#include "ImageMask.h"

namespace {

const ThemeColor* findColor(const char* code) {
  const CurrentTheme& current = CurrentTheme::get();
  return code && current.colors ? current.colors->find(code, current.style()) : nullptr;
}

void give(int* output, int value) {
  if (output) *output = value;
}

}  // namespace

Eina_Bool ea_theme_color_get(const char* code, int* r, int* g, int* b, int* a, int* r2, int* g2,
                             int* b2, int* a2, int* r3, int* g3, int* b3, int* a3) {
  const ThemeColor* color = findColor(code);
  if (!color) return EINA_FALSE;
  give(r, color->r);
  give(g, color->g);
  give(b, color->b);
  give(a, color->a);
  // The tables know neither outlines nor shadows.
  for (int* none : {r2, g2, b2, a2, r3, g3, b3, a3}) give(none, 0);
  return EINA_TRUE;
}

Eina_Bool ea_theme_font_get(const char* code, char** font, int* size) {
  const FontTable* fonts = CurrentTheme::get().fonts;
  const ThemeFont* found = code && fonts ? fonts->find(code) : nullptr;
  if (!found) return EINA_FALSE;
  if (font) *font = strdup(found->name.c_str());
  give(size, found->size);
  return EINA_TRUE;
}

Eina_Bool ea_theme_object_color_set(Evas_Object* obj, const char* code) {
  const ThemeColor* color = findColor(code);
  if (!obj || !color) return EINA_FALSE;
  // The canvas takes premultiplied colours.
  const auto premultiplied = [color](int value) { return value * color->a / 255; };
  evas_object_color_set(obj, premultiplied(color->r), premultiplied(color->g),
                        premultiplied(color->b), color->a);
  return EINA_TRUE;
}

void* ea_image_effect_mask(const char* image, const char* mask, int w, int h, int mask_x,
                           int mask_y) {
  return maskImage(image, mask, w, h, mask_x, mask_y);
}
