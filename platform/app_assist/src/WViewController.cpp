#include "app_assist/WViewController.h"

#include "ClipRecords.h"
#include "ViewPrivate.h"

namespace app_assist {

WViewController::WViewController() : _v(std::make_unique<Private>()) {}

WViewController::~WViewController() {
  if (!_v->view) return;
  // The derived part is gone already, so nobody can be told.
  evas_object_event_callback_del_full(_v->view, EVAS_CALLBACK_DEL, Private::viewDeletedCb, this);
  evas_object_del(_v->view);
}

const char* WViewController::getClassName() {
  return "WViewController";
}

bool WViewController::create(Evas_Object* parent, void* viewParam) {
  if (_v->view || !onPrepare()) return false;
  _v->view = onCreateView(parent, viewParam);
  if (!_v->view) return false;
  evas_object_event_callback_add(_v->view, EVAS_CALLBACK_DEL, Private::viewDeletedCb, this);
  onCreated();
  return _v->view != nullptr;
}

void WViewController::destroy() {
  if (_v->view) evas_object_del(_v->view);
}

bool WViewController::onPrepare() {
  return true;
}

Evas_Object* WViewController::onCreateView(Evas_Object*, void*) {
  return nullptr;
}

void WViewController::onCreated() {}

Evas_Object* WViewController::onViewDeleted(Evas_Object* view) {
  return view;
}

Evas_Object* WViewController::getEvasObj() const {
  return _v->view;
}

WWindowController* WViewController::getWindowController() const {
  return _v->window;
}

void WViewController::Private::viewDeletedCb(void* data, Evas*, Evas_Object* view, void*) {
  auto* self = static_cast<WViewController*>(data);
  self->_v->view = nullptr;
  ownClipRecords(view);
  self->onViewDeleted(view);
}

}  // namespace app_assist
