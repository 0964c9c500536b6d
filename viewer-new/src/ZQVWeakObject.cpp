#include "ZQVWeakObject.h"

void ZQVWeakObject::set(Evas_Object* object) {
  if (_object) {
    evas_object_event_callback_del_full(_object, EVAS_CALLBACK_DEL, _deletedCb, this);
  }
  _object = object;
  if (_object) evas_object_event_callback_add(_object, EVAS_CALLBACK_DEL, _deletedCb, this);
}

void ZQVWeakObject::_deletedCb(void* data, Evas*, Evas_Object*, void*) {
  static_cast<ZQVWeakObject*>(data)->_object = nullptr;
}
