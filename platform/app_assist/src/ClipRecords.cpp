#include "ClipRecords.h"

#include <cstring>

#include "WidgetWalk.h"

namespace app_assist {
namespace {

using Record = Evas_Object_Smart_Clipped_Data;

void freeCb(void* record, Evas*, Evas_Object*, void*) {
  delete static_cast<Record*>(record);
}

/// The toolkit frees its own record when it is given another, which stays ours.
bool own(Evas_Object* object, const char* type) {
  if (strcmp(type, "edje") != 0) return true;
  const auto* theirs = static_cast<const Record*>(evas_object_smart_data_get(object));
  if (!theirs) return true;
  auto* ours = new Record(*theirs);
  evas_object_smart_data_set(object, ours);
  evas_object_event_callback_add(object, EVAS_CALLBACK_FREE, freeCb, ours);
  return true;
}

}  // namespace

void ownClipRecords(Evas_Object* view) {
  walkWithin(view, own);
}

}  // namespace app_assist
