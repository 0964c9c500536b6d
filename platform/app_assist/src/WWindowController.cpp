#include "app_assist/WWindowController.h"

#include <dlog.h>

#include <cstring>

#include "ViewPrivate.h"
#include "WindowPrivate.h"
#include "app_assist/WNaviframeController.h"
#include "app_assist/WPopupController.h"

namespace app_assist {
namespace {

constexpr const char* kBackKeys[] = {"XF86Back", "Escape"};

bool isBackKey(const char* key) {
  for (const char* back : kBackKeys) {
    if (key && strcmp(key, back) == 0) return true;
  }
  return false;
}

}  // namespace

WWindowController::WWindowController(const char* name, Elm_Win_Type type)
    : _d(std::make_unique<Private>(this, name, type)) {}

WWindowController::~WWindowController() {
  _d->close();
}

Evas_Object* WWindowController::getEvasObj() {
  return _d->window;
}

WViewController* WWindowController::getBaseViewController() {
  return _d->base.get();
}

void WWindowController::attachBaseViewController(WViewController* base) {
  _d->base.reset(base);
  if (_d->window) _d->showBase();
}

void WWindowController::Private::open() {
  if (window) return;
  window = elm_win_add(nullptr, name.c_str(), type);
  if (!window) {
    dlog_print(DLOG_ERROR, "APP_ASSIST", "no window: is there a display?");
    return;
  }
  elm_win_title_set(window, name.c_str());
  evas_object_smart_callback_add(window, "delete,request", closeRequestCb, this);
  evas_object_event_callback_add(window, EVAS_CALLBACK_DEL, windowDeletedCb, this);
  // Exclusive: an entry or a popup must not make something else of it as well.
  for (const char* key : kBackKeys) {
    if (!evas_object_key_grab(window, key, 0, 0, EINA_TRUE))
      dlog_print(DLOG_WARN, "APP_ASSIST", "no key %s", key);
  }
  evas_object_event_callback_add(window, EVAS_CALLBACK_KEY_DOWN, keyDownCb, this);

  frame = elm_layout_add(window);
  elm_layout_theme_set(frame, "layout", "phone", "window");
  evas_object_size_hint_weight_set(frame, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  elm_win_resize_object_add(window, frame);
  evas_object_show(frame);
  strip = std::make_unique<StatusStrip>(window, frame);
  orientation = std::make_unique<Orientation>([this](int degrees) { rotate(degrees); });

  showBase();
  int width = 0, height = 0;
  elm_win_screen_size_get(window, nullptr, nullptr, &width, &height);
  evas_object_resize(window, width, height);
  evas_object_show(window);
}

void WWindowController::Private::close() {
  orientation.reset();
  strip.reset();
  base.reset();
  if (window) evas_object_del(window);
}

void WWindowController::Private::showBase() {
  if (!base || base->getEvasObj()) return;
  base->_v->window = self;
  if (base->create(frame, nullptr)) elm_object_content_set(frame, base->getEvasObj());
}

void WWindowController::Private::rotate(int degrees) {
  if (elm_win_rotation_get(window) != degrees) elm_win_rotation_with_resize_set(window, degrees);
}

void WWindowController::Private::back() {
  if (!popups.empty()) {
    popups.back()->close();
  } else if (hasForeignPopup()) {
    return;
  } else if (auto* naviframe = dynamic_cast<WNaviframeController*>(base.get())) {
    naviframe->pop();
  }
}

/// A popup that an application made by itself: only the application closes it, and what is below
/// is out of reach.
bool WWindowController::Private::hasForeignPopup() const {
  Evas_Object* object = evas_object_top_get(evas_object_evas_get(window));
  for (; object; object = evas_object_below_get(object)) {
    const char* type = evas_object_type_get(object);
    if (type && strcmp(type, "elm_popup") == 0 && evas_object_visible_get(object)) return true;
  }
  return false;
}

void WWindowController::Private::keyDownCb(void* data, Evas*, Evas_Object*, void* event) {
  const auto* key = static_cast<Evas_Event_Key_Down*>(event);
  if (isBackKey(key->key)) static_cast<Private*>(data)->back();
}

void WWindowController::Private::closeRequestCb(void*, Evas_Object*, void*) {
  elm_exit();
}

void WWindowController::Private::windowDeletedCb(void* data, Evas*, Evas_Object*, void*) {
  auto* self = static_cast<Private*>(data);
  self->window = nullptr;
  self->frame = nullptr;
}

}  // namespace app_assist
