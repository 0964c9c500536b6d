#include "app_assist/WContentViewController.h"

#include <dlog.h>

#include "ContentPrivate.h"
#include "LateDestroyer.h"
#include "PopupPrivate.h"
#include "ViewPrivate.h"
#include "WindowPrivate.h"
#include "app_assist/WPopupController.h"

namespace app_assist {

WContentViewController::WContentViewController() : _c(std::make_unique<Private>()) {}

WContentViewController::~WContentViewController() {
  _c->closePopups();
}

void WContentViewController::onSetContainerProperties() {}

Elm_Object_Item* WContentViewController::onPushToNaviframe(Evas_Object* naviframe) {
  return elm_naviframe_item_push(naviframe, getTitle(), nullptr, nullptr, getEvasObj(),
                                 _c->itemStyle.empty() ? nullptr : getItemStyle());
}

void WContentViewController::onPushed(Elm_Object_Item*) {}

bool WContentViewController::onPop() {
  return true;
}

void WContentViewController::onBecomeTop() {}

void WContentViewController::onSetAsPageContent() {}

void WContentViewController::onSetMoreButton() {}

void WContentViewController::setTitle(const char* title) {
  _c->title = title ? title : "";
  if (!_c->item) return;
  elm_object_item_text_set(_c->item, getTitle());
  // The page that screen readers see is the item's own layout, and the toolkit gives that the first
  // title for ever.
  efl_access_object_i18n_name_set(elm_object_parent_widget_get(getEvasObj()), getTitle());
}

const char* WContentViewController::getTitle() const {
  return _c->title.c_str();
}

WNaviframeController* WContentViewController::getNaviframe() const {
  return _c->naviframe;
}

Elm_Object_Item* WContentViewController::getNaviItem() const {
  return _c->item;
}

const char* WContentViewController::getItemStyle() const {
  return _c->itemStyle.c_str();
}

void WContentViewController::attachPopup(WPopupController* popup) {
  if (!popup) return;
  WWindowController* window = getWindowController();
  popup->_p->open = true;
  popup->_p->page = this;
  popup->_v->window = window;
  _c->popups.push_back(popup);
  if (!window || _c->ending || !popup->create(window->getEvasObj(), nullptr)) {
    dlog_print(DLOG_ERROR, "APP_ASSIST", "popup %s is not shown", popup->getClassName());
    popup->close();
    return;
  }
  popup->_p->watchView(popup);
  window->_d->popups.push_back(popup);
}

void WContentViewController::Private::closePopups() {
  ending = true;
  const std::vector<WPopupController*> open = popups;
  for (WPopupController* popup : open) WPopupController::PopupPrivate::end(popup);
}

}  // namespace app_assist
