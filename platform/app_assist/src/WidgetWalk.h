/// Everything that a window shows, from the bottom up.
#pragma once

#include <Elementary.h>

#include <functional>

namespace app_assist {

/// Gets each object with the name of its type, and says whether what is inside matters, too.
using See = std::function<bool(Evas_Object* object, const char* type)>;

void walkWidgets(Evas_Object* window, const See& see);
/// The object itself, and what is in it.
void walkWithin(Evas_Object* object, const See& see);

}  // namespace app_assist
