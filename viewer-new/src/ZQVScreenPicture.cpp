#include "ZQVScreenPicture.h"

#include <algorithm>

#include "ZQVFilePages.h"
#include "ZQVPictureGate.h"

// Deleted with the picture.
void ZQVScreenPicture::follow(Evas_Object* picture, const char* path, Evas_Object* pager,
                              First first) {
  new ZQVScreenPicture(picture, path, pager, first);
}

int ZQVScreenPicture::sizeOn(Evas_Object* pager, const char* path) {
  int width = 0;
  int height = 0;
  elm_gengrid_item_size_get(pager, &width, &height);
  if (width <= 0 || height <= 0) return 0;
  // Other kinds are decoded whole whatever the prescale; a new one would decode them once more.
  if (!ZQVPictureGate::decodingOf(path).isReducible) return kFirstSize;
  return std::max({width, height, kFirstSize});
}

ZQVScreenPicture::ZQVScreenPicture(Evas_Object* picture, const char* path, Evas_Object* pager,
                                   First first)
    : _picture(picture), _pager(pager), _path(path), _first(first) {
  evas_object_event_callback_add(picture, EVAS_CALLBACK_RESIZE, _resizedCb, this);
  evas_object_event_callback_add(picture, EVAS_CALLBACK_DEL, _deletedCb, this);
}

void ZQVScreenPicture::_resizedCb(void* data, Evas*, Evas_Object*, void*) {
  static_cast<ZQVScreenPicture*>(data)->_fit();
}

void ZQVScreenPicture::_decodedCb(void* data, Evas*, Evas_Object*, void*) {
  auto* self = static_cast<ZQVScreenPicture*>(data);
  self->_isSeen = true;
  self->_show();
}

void ZQVScreenPicture::_deletedCb(void* data, Evas*, Evas_Object*, void*) {
  delete static_cast<ZQVScreenPicture*>(data);
}

void ZQVScreenPicture::_fit() {
  const int size = sizeOn(_pager, _path.c_str());
  if (size == 0 || size == _size) return;
  _size = size;
  _isSharp = false;
  _preload.start(evas_object_evas_get(_picture), _path.c_str(), size, [this] {
    _isSharp = true;
    _show();
  });
  if (_isSeen || _isWaiting) return;
  // Sharp at once where the neighbouring page has had it decoded.
  _isSeen = _isSharp || _first == First::AtOnce;
  _isSeen ? _show() : _showWhenDecoded();
}

void ZQVScreenPicture::_showWhenDecoded() {
  _isWaiting = true;
  ZQVFilePages::dropWhenDecoded(elm_image_object_get(_picture));
  evas_object_event_callback_add(elm_image_object_get(_picture), EVAS_CALLBACK_IMAGE_PRELOADED,
                                 _decodedCb, this);
  elm_image_preload_disabled_set(_picture, EINA_FALSE);
}

/// A picture that is still being decoded small would never come if its size changed now.
void ZQVScreenPicture::_show() {
  if (_isSeen && _isSharp) elm_image_prescale_set(_picture, _size);
}
