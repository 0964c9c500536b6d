/// Everything that a window shows, from the bottom up.
#pragma once

#include <Elementary.h>

#include <functional>

namespace app_assist {

/// `see` gets each object with the name of its type, and says whether what is inside matters, too.
void walkWidgets(Evas_Object* window,
                 const std::function<bool(Evas_Object* object, const char* type)>& see);

}  // namespace app_assist
