#include "WidgetWalk.h"

namespace app_assist {

void walkWithin(Evas_Object* object, const See& see) {
  const char* type = evas_object_type_get(object);
  if (!type || !see(object, type) || !efl_isa(object, EFL_CANVAS_GROUP_CLASS)) return;
  Eina_List* members = evas_object_smart_members_get(object);
  while (members) {
    walkWithin(static_cast<Evas_Object*>(eina_list_data_get(members)), see);
    members = eina_list_remove_list(members, members);
  }
}

void walkWidgets(Evas_Object* window, const See& see) {
  Evas_Object* object = evas_object_bottom_get(evas_object_evas_get(window));
  for (; object; object = evas_object_above_get(object)) walkWithin(object, see);
}

}  // namespace app_assist
