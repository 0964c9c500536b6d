#pragma once

#include <Evas.h>

#include <functional>

#include "ZQVWeakObject.h"

/// Has a picture decoded in the background. Until the next start() or stop(), every image of this
/// canvas that shows the file at that size finds it decoded.
class ZQVPicturePreload {
 public:
  ZQVPicturePreload() = default;
  ~ZQVPicturePreload() { stop(); }
  ZQVPicturePreload(const ZQVPicturePreload&) = delete;
  ZQVPicturePreload& operator=(const ZQVPicturePreload&) = delete;

  /// `size` in pixels is the prescale of the images that are to find it. `done` may be called
  /// before start() returns; a file that is no picture is done, too.
  void start(Evas* canvas, const char* path, int size, std::function<void()> done);
  void stop();

 private:
  static void _preloadedCb(void* data, Evas* canvas, Evas_Object* image, void* info);

  ZQVWeakObject _image;
  std::function<void()> _done;
};
