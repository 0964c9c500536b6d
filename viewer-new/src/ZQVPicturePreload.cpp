#include "ZQVPicturePreload.h"

#include <utility>

#include "ZQVFilePages.h"

void ZQVPicturePreload::start(Evas* canvas, const char* path, int size,
                              std::function<void()> done) {
  stop();
  _done = std::move(done);
  _image = evas_object_image_filled_add(canvas);
  ZQVFilePages::dropWhenDecoded(_image);
  evas_object_event_callback_add(_image, EVAS_CALLBACK_IMAGE_PRELOADED, _preloadedCb, this);
  // As the image widget has it: only then is it the same picture to the toolkit.
  evas_object_image_load_orientation_set(_image, EINA_TRUE);
  evas_object_image_load_size_set(_image, size, size);
  evas_object_image_file_set(_image, path, nullptr);
  evas_object_image_preload(_image, EINA_FALSE);
}

void ZQVPicturePreload::stop() {
  _done = nullptr;
  if (!_image) return;
  evas_object_event_callback_del_full(_image, EVAS_CALLBACK_IMAGE_PRELOADED, _preloadedCb, this);
  evas_object_del(_image);
}

void ZQVPicturePreload::_preloadedCb(void* data, Evas*, Evas_Object*, void*) {
  // It may start another preload, which drops this one's.
  const auto done = std::exchange(static_cast<ZQVPicturePreload*>(data)->_done, nullptr);
  if (done) done();
}
