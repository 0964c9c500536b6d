#include "app_assist/WPopupController.h"

#include <algorithm>

#include "ContentPrivate.h"
#include "LateDestroyer.h"
#include "PopupPrivate.h"
#include "ViewPrivate.h"
#include "WindowPrivate.h"

namespace app_assist {
namespace {

constexpr size_t kMaxButtons = 3;

void erase(std::vector<WPopupController*>& popups, WPopupController* popup) {
  popups.erase(std::remove(popups.begin(), popups.end(), popup), popups.end());
}

}  // namespace

WPopupController::WPopupController() : _p(std::make_unique<PopupPrivate>()) {}

WPopupController::~WPopupController() {
  *_p->alive = false;
  if (!_v->view) return;
  evas_object_event_callback_del_full(_v->view, EVAS_CALLBACK_DEL, PopupPrivate::viewDeletedCb,
                                      this);
}

Evas_Object* WPopupController::onCreateView(Evas_Object* parent, void*) {
  Evas_Object* popup = elm_popup_add(parent);
  if (!popup) return nullptr;
  elm_popup_orient_set(popup, ELM_POPUP_ORIENT_BOTTOM);
  evas_object_size_hint_weight_set(popup, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  if (!_p->title.empty()) _p->setText(popup, "title,text", _p->title);
  _p->addContent(popup);
  _p->addButtons(popup);
  evas_object_smart_callback_add(popup, "dismissed", PopupPrivate::dismissedCb, this);
  evas_object_show(popup);
  return popup;
}

void WPopupController::setTextDomain(const char* domain) {
  _p->domain = domain ? domain : "";
}

void WPopupController::setTitle(const char* id) {
  _p->title = id ? id : "";
}

void WPopupController::setContent(const char* id) {
  _p->text = id ? id : "";
}

void WPopupController::setContent(ContentBuilder builder) {
  _p->builder = std::move(builder);
}

void WPopupController::addButton(const char* id, ButtonHandler handler) {
  if (!id || _p->buttons.size() >= kMaxButtons) return;
  _p->buttons.push_back(
      std::make_unique<PopupPrivate::Button>(PopupPrivate::Button{this, id, std::move(handler)}));
}

/// It slides out as long as its page is there to be looked at, and ends once it is out of sight.
void WPopupController::close() {
  if (!_p->open) return;
  PopupPrivate::stop(this);
  const bool canBeSeen = _v->view && evas_object_visible_get(_v->view);
  if (canBeSeen && !_p->page->_c->ending) {
    elm_popup_dismiss(_v->view);
  } else {
    PopupPrivate::end(this);
  }
}

/// From now on it takes no presses, and back goes to what is below.
void WPopupController::PopupPrivate::stop(WPopupController* popup) {
  popup->_p->open = false;
  if (popup->_v->window) erase(popup->_v->window->_d->popups, popup);
}

void WPopupController::PopupPrivate::end(WPopupController* popup) {
  stop(popup);
  if (!popup->_p->page) return;
  erase(popup->_p->page->_c->popups, popup);
  popup->_p->page = nullptr;
  LateDestroyer::instance().add(std::unique_ptr<WViewController>(popup));
}

void WPopupController::PopupPrivate::setText(Evas_Object* object, const char* part,
                                             const std::string& id) const {
  if (domain.empty()) {
    elm_object_part_text_set(object, part, id.c_str());
  } else {
    elm_object_domain_translatable_part_text_set(object, part, domain.c_str(), id.c_str());
  }
}

void WPopupController::PopupPrivate::addContent(Evas_Object* popup) const {
  if (!text.empty()) setText(popup, nullptr, text);
  if (!builder) return;
  if (Evas_Object* content = builder(popup)) elm_object_content_set(popup, content);
}

void WPopupController::PopupPrivate::addButtons(Evas_Object* popup) const {
  int number = 0;
  for (const auto& entry : buttons) {
    Evas_Object* button = elm_button_add(popup);
    elm_object_style_set(button, "popup/default");
    setText(button, nullptr, entry->id);
    evas_object_smart_callback_add(button, "clicked", clickedCb, entry.get());
    elm_object_part_content_set(popup, ("button" + std::to_string(++number)).c_str(), button);
  }
}

/// Whoever deletes the object ends the controller with it.
void WPopupController::PopupPrivate::watchView(WPopupController* popup) {
  evas_object_event_callback_add(popup->_v->view, EVAS_CALLBACK_DEL, viewDeletedCb, popup);
}

/// The handler may end the page and the popup with it, so everything it needs is copied first.
void WPopupController::PopupPrivate::clickedCb(void* data, Evas_Object*, void*) {
  const auto* button = static_cast<Button*>(data);
  WPopupController* popup = button->popup;
  if (!popup->_p->open) return;
  const ButtonHandler handler = button->handler;
  const std::shared_ptr<bool> alive = popup->_p->alive;
  bool close = false;
  if (handler) handler(&close);
  if (close && *alive) popup->close();
}

void WPopupController::PopupPrivate::dismissedCb(void* data, Evas_Object*, void*) {
  end(static_cast<WPopupController*>(data));
}

void WPopupController::PopupPrivate::viewDeletedCb(void* data, Evas*, Evas_Object*, void*) {
  end(static_cast<WPopupController*>(data));
}

}  // namespace app_assist
