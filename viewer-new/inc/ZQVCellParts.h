/// What the cells of all grids are made of.
#pragma once

#include <Elementary.h>

/// Does the text contain the other one? Null contains nothing.
bool zqvContains(const char* text, const char* part);

/// A one-line label with an ellipsis. `markup` is already escaped. Null without a parent.
Evas_Object* zqvCreateLabel(Evas_Object* parent, const char* markup);

/// An icon in a colour of the theme, in a part of the layout; `owner` is the icon's parent.
Evas_Object* zqvAddColouredIcon(Evas_Object* owner, Evas_Object* layout, const char* part,
                                const char* path, const char* colour);
