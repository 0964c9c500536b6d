/// Colours, fonts and picture effects of the device theme, by code.
#pragma once

#include <Evas.h>

#ifdef __cplusplus
extern "C" {
#endif

/// The code's colour, outline (2) and shadow (3): 0 to 255, not premultiplied. Any output may be
/// null. False when the code is unknown.
Eina_Bool ea_theme_color_get(const char* code, int* r, int* g, int* b, int* a, int* r2, int* g2,
                             int* b2, int* a2, int* r3, int* g3, int* b3, int* a3);

/// The code's font name with its style, to be freed with free(), and its size in pixels. False when
/// the code is unknown; the outputs are then untouched.
Eina_Bool ea_theme_font_get(const char* code, char** font, int* size);

/// Gives the object the code's colour, now and whenever the palette changes. False when the code is
/// unknown.
Eina_Bool ea_theme_object_color_set(Evas_Object* obj, const char* code);

/// The picture, filling w x h pixels, cut out by the opacity of the PNG `mask`, whose upper left
/// corner lies at (mask_x, mask_y). 32-bit premultiplied ARGB of w x h x 4 bytes, to be freed with
/// free(); null on failure.
void* ea_image_effect_mask(const char* image, const char* mask, int w, int h, int mask_x,
                           int mask_y);

#ifdef __cplusplus
}
#endif
