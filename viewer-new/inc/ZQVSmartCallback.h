#pragma once

#include <Evas.h>

#include "ZQVWeakObject.h"

/// A smart callback on an object that outlives its listener, such as the window. Registered as long
/// as this lives and only this registration is taken back.
class ZQVSmartCallback {
 public:
  ZQVSmartCallback() = default;
  ~ZQVSmartCallback() { disconnect(); }
  ZQVSmartCallback(const ZQVSmartCallback&) = delete;
  ZQVSmartCallback& operator=(const ZQVSmartCallback&) = delete;

  /// `event` is a literal.
  void connect(Evas_Object* object, const char* event, Evas_Smart_Cb callback, void* data);
  void disconnect();

 private:
  ZQVWeakObject _object;
  const char* _event = nullptr;
  Evas_Smart_Cb _callback = nullptr;
  void* _data = nullptr;
};
