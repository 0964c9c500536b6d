#pragma once

#include <Elementary.h>

#include "ZQVTimer.h"

/// What turns an image into a cycle of pictures. It belongs to the image and ends with it.
class ZQVFrameAnimation {
 public:
  /// `frames` is null-terminated, not empty, and outlives the image. Null when there is no list.
  static Evas_Object* create(Evas_Object* parent, const char** frames);
  /// From the next tick on the image shows the new list, beginning with its second frame.
  static void update(Evas_Object* image, const char** frames);

 private:
  ZQVFrameAnimation(Evas_Object* image, const char** frames);
  static ZQVFrameAnimation* _of(Evas_Object* image);
  static bool _gif_updater(Evas_Object* image);
  static void _gif_del_cb(void* data, Evas* canvas, Evas_Object* image, void* info);
  void _advance();

  const char** _frames;
  int _index = 0;
  ZQVTimer _timer;
};
