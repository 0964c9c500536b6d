#include "Direction.h"

#include <cstring>

#include "WidgetWalk.h"

namespace app_assist {
namespace {

/// A list that is moved measures its rows. Nobody sees it: it is back before the next frame.
void measureRows(Evas_Object* list) {
  int x = 0, y = 0;
  evas_object_geometry_get(list, &x, &y, nullptr, nullptr);
  evas_object_move(list, x + 1, y);
  evas_object_move(list, x, y);
}

}  // namespace

void followDirection(Evas_Object* window) {
  walkWidgets(window, [](Evas_Object* object, const char* type) {
    if (strcmp(type, "elm_genlist") == 0) measureRows(object);
    if (strcmp(type, "elm_layout") == 0)
      edje_object_mirrored_set(elm_layout_edje_get(object), elm_config_mirrored_get());
    return true;
  });
}

}  // namespace app_assist
