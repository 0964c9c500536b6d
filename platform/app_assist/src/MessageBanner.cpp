#include "MessageBanner.h"

namespace app_assist {

MessageBanner::MessageBanner(Evas_Object* window)
    : _window(window), _banner(elm_layout_add(window)) {
  elm_layout_theme_set(_banner, "layout", "phone", "message");
  evas_object_pass_events_set(_banner, EINA_TRUE);
  evas_object_layer_set(_banner, EVAS_LAYER_MAX);
  evas_object_event_callback_add(_banner, EVAS_CALLBACK_DEL, bannerDeletedCb, this);
  evas_object_event_callback_add(window, EVAS_CALLBACK_RESIZE, windowResizedCb, this);
  windowResizedCb(this, nullptr, window, nullptr);
}

MessageBanner::~MessageBanner() {
  if (!_banner) return;
  evas_object_event_callback_del_full(_window, EVAS_CALLBACK_RESIZE, windowResizedCb, this);
  evas_object_event_callback_del_full(_banner, EVAS_CALLBACK_DEL, bannerDeletedCb, this);
  evas_object_del(_banner);
}

void MessageBanner::show(const char* markup) {
  if (!_banner) return;
  elm_object_text_set(_banner, markup);
  evas_object_show(_banner);
  elm_object_signal_emit(_banner, "message,show", "elm");
}

void MessageBanner::windowResizedCb(void* data, Evas*, Evas_Object* window, void*) {
  auto* self = static_cast<MessageBanner*>(data);
  int width = 0, height = 0;
  evas_object_geometry_get(window, nullptr, nullptr, &width, &height);
  evas_object_resize(self->_banner, width, height);
}

/// The window took it along.
void MessageBanner::bannerDeletedCb(void* data, Evas*, Evas_Object*, void*) {
  static_cast<MessageBanner*>(data)->_banner = nullptr;
}

}  // namespace app_assist
