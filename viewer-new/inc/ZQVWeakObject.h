#pragma once

#include <Evas.h>

/// A pointer to an object that the toolkit owns; null once the object is deleted.
class ZQVWeakObject {
 public:
  ZQVWeakObject() = default;
  explicit ZQVWeakObject(Evas_Object* object) { set(object); }
  ~ZQVWeakObject() { set(nullptr); }
  ZQVWeakObject(const ZQVWeakObject&) = delete;
  ZQVWeakObject& operator=(const ZQVWeakObject&) = delete;
  ZQVWeakObject& operator=(Evas_Object* object) {
    set(object);
    return *this;
  }

  void set(Evas_Object* object);
  Evas_Object* get() const { return _object; }
  operator Evas_Object*() const { return _object; }

 private:
  static void _deletedCb(void* data, Evas* canvas, Evas_Object* object, void* info);

  Evas_Object* _object = nullptr;
};
