/// Theme colours and fonts by code, and the image mask.
#pragma once

#include <Elementary.h>

#ifdef __cplusplus
extern "C" {
#endif

/// The code's colour, its outline (2) and shadow (3), 0 to 255 each, straight alpha. Null outputs
/// are skipped. False, and nothing written, when the code is unknown.
Eina_Bool ea_theme_color_get(const char* code, int* r, int* g, int* b, int* a, int* r2, int* g2,
                             int* b2, int* a2, int* r3, int* g3, int* b3, int* a3);

/// The code's font, name and style, and its size in pixels. The caller frees `font` with free().
/// False, and nothing written, when the code is unknown.
Eina_Bool ea_theme_font_get(const char* code, char** font, int* size);

/// Colours the object with the code's colour; false when the code is unknown.
Eina_Bool ea_theme_object_color_set(Evas_Object* obj, const char* code);

/// The picture, scaled to fill w x h, seen through the mask's alpha laid at (mask_x, mask_y):
/// w x h pixels of premultiplied 32-bit ARGB that the caller frees with free(). Null when either
/// file cannot be read.
void* ea_image_effect_mask(const char* image, const char* mask, int w, int h, int mask_x,
                           int mask_y);

#ifdef __cplusplus
}
#endif
