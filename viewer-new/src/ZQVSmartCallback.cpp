#include "ZQVSmartCallback.h"

void ZQVSmartCallback::connect(Evas_Object* object, const char* event, Evas_Smart_Cb callback,
                               void* data) {
  disconnect();
  _object = object;
  _event = event;
  _callback = callback;
  _data = data;
  if (_object) evas_object_smart_callback_add(_object, _event, _callback, _data);
}

void ZQVSmartCallback::disconnect() {
  if (_object) evas_object_smart_callback_del_full(_object, _event, _callback, _data);
  _object = nullptr;
}
