#include "ZQVFrameAnimation.h"

#include <new>

#include "ZQVLog.h"

namespace {

constexpr const char* kRecordKey = "gif_data";
constexpr double kFrameTime = 0.3;

void showFrame(Evas_Object* image, const char* path) {
  int width = 0;
  int height = 0;
  elm_image_file_set(image, path, nullptr);
  elm_image_object_size_get(image, &width, &height);
  evas_object_size_hint_min_set(image, width, height);
  evas_object_size_hint_max_set(image, width, height);
  evas_object_resize(image, width, height);
}

}  // namespace

Evas_Object* ZQVFrameAnimation::create(Evas_Object* parent, const char** frames) {
  if (!frames || !*frames) {
    ZQV_ERROR("!png_list");
    return nullptr;
  }
  Evas_Object* image = elm_image_add(parent);
  auto* record = new (std::nothrow) ZQVFrameAnimation(image, frames);
  if (!record) {
    ZQV_ERROR("calloc failed");
    evas_object_del(image);
    return nullptr;
  }
  elm_image_resizable_set(image, EINA_TRUE, EINA_TRUE);
  showFrame(image, *frames);
  evas_object_show(image);
  evas_object_data_set(image, kRecordKey, record);
  evas_object_event_callback_add(image, EVAS_CALLBACK_DEL, _gif_del_cb, record);
  return image;
}

void ZQVFrameAnimation::update(Evas_Object* image, const char** frames) {
  if (!frames || !*frames) {
    ZQV_ERROR("!png_list");
    return;
  }
  ZQVFrameAnimation* record = _of(image);
  if (!record) return;
  record->_frames = frames;
  record->_index = 0;
}

ZQVFrameAnimation::ZQVFrameAnimation(Evas_Object* image, const char** frames) : _frames(frames) {
  _timer.start(kFrameTime, [image] { return _gif_updater(image); });
}

ZQVFrameAnimation* ZQVFrameAnimation::_of(Evas_Object* image) {
  return image ? static_cast<ZQVFrameAnimation*>(evas_object_data_get(image, kRecordKey)) : nullptr;
}

bool ZQVFrameAnimation::_gif_updater(Evas_Object* image) {
  if (!image) {
    ZQV_ERROR("!data");
    return false;
  }
  ZQVFrameAnimation* record = _of(image);
  if (!record) {
    ZQV_ERROR("!gif_data");
    return false;
  }
  record->_advance();
  showFrame(image, record->_frames[record->_index]);
  return true;
}

void ZQVFrameAnimation::_advance() {
  ++_index;
  if (!_frames[_index]) _index = 0;
}

void ZQVFrameAnimation::_gif_del_cb(void* data, Evas*, Evas_Object* image, void*) {
  if (!data) {
    ZQV_ERROR("!data");
    return;
  }
  evas_object_data_del(image, kRecordKey);
  delete static_cast<ZQVFrameAnimation*>(data);
}
