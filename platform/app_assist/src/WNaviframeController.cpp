#include "app_assist/WNaviframeController.h"

#include <dlog.h>

#include <algorithm>
#include <utility>

#include "ContentPrivate.h"
#include "LateDestroyer.h"
#include "NaviframePrivate.h"
#include "ViewPrivate.h"

namespace app_assist {

WNaviframeController::WNaviframeController() : _n(std::make_unique<NaviPrivate>(this)) {}

WNaviframeController::~WNaviframeController() {
  destroyAllViewControllers();
}

Evas_Object* WNaviframeController::onCreateView(Evas_Object* parent, void*) {
  Evas_Object* naviframe = elm_naviframe_add(parent);
  elm_naviframe_prev_btn_auto_pushed_set(naviframe, EINA_FALSE);
  evas_object_size_hint_weight_set(naviframe, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  evas_object_smart_callback_add(naviframe, "transition,finished", NaviPrivate::arrivedCb,
                                 _n.get());
  evas_object_show(naviframe);
  return naviframe;
}

void WNaviframeController::push(WContentViewController* view, void* viewParam,
                                const char* itemStyle) {
  if (!view) return;
  view->_c->naviframe = this;
  view->_c->itemStyle = itemStyle ? itemStyle : "";
  view->_v->window = getWindowController();
  if (_n->add(view, viewParam)) return;
  dlog_print(DLOG_ERROR, "APP_ASSIST", "view %s is not shown", view->getClassName());
  view->_c->closePopups();
  LateDestroyer::instance().add(std::unique_ptr<WViewController>(view));
}

void WNaviframeController::pop() {
  if (!getEvasObj()) return;
  if (_n->arriving) {
    _n->pendingPops++;
  } else {
    elm_naviframe_item_pop(getEvasObj());
  }
}

void WNaviframeController::destroyAllViewControllers() {
  _n->pendingPops = 0;
  // Popups speak to their pages when they go, so they go while the pages are whole.
  for (WContentViewController* view : _n->pages) view->_c->closePopups();
  LateDestroyer::instance().flush();
  while (Elm_Object_Item* top = getEvasObj() ? elm_naviframe_top_item_get(getEvasObj()) : nullptr)
    elm_object_item_del(top);
  // What is left slides out: the toolkit keeps its item until then, empty.
  const std::vector<WContentViewController*> leaving = _n->pages;
  for (WContentViewController* view : leaving) {
    elm_object_item_del_cb_set(view->_c->item, nullptr);
    elm_object_item_data_set(view->_c->item, nullptr);
    _n->remove(view);
  }
  LateDestroyer::instance().flush();
}

void WNaviframeController::setOnLastItemPop(std::function<void(bool*)> handler) {
  _n->onLastItemPop = std::move(handler);
}

WNaviframeController::NaviPrivate::~NaviPrivate() {
  if (later) ecore_job_del(later);
}

bool WNaviframeController::NaviPrivate::add(WContentViewController* view, void* viewParam) {
  Evas_Object* naviframe = self->getEvasObj();
  if (!naviframe || !view->create(naviframe, viewParam)) return false;
  view->onSetContainerProperties();
  Elm_Object_Item* below = elm_naviframe_top_item_get(naviframe);
  Elm_Object_Item* item = view->onPushToNaviframe(naviframe);
  if (!item) return false;
  pages.push_back(view);
  view->_c->item = item;
  arriving = below ? item : nullptr;
  pendingPops = 0;
  elm_object_item_data_set(item, view);
  elm_object_item_del_cb_set(item, itemDeletedCb);
  elm_naviframe_item_pop_cb_set(item, popCb, view);
  view->onSetAsPageContent();
  view->onPushed(item);
  view->onSetMoreButton();
  return true;
}

/// The item is gone or about to go.
void WNaviframeController::NaviPrivate::remove(WContentViewController* view) {
  pages.erase(std::remove(pages.begin(), pages.end(), view), pages.end());
  if (uncovered == view) uncovered = nullptr;
  if (arriving == view->_c->item) arriving = nullptr;
  view->_c->item = nullptr;
  view->_c->closePopups();
  LateDestroyer::instance().add(std::unique_ptr<WViewController>(view));
}

bool WNaviframeController::NaviPrivate::allowPop(WContentViewController* view,
                                                 Elm_Object_Item* item) {
  if (item == elm_naviframe_bottom_item_get(self->getEvasObj()) && onLastItemPop) {
    bool handled = false;
    const auto handler = onLastItemPop;
    handler(&handled);
    if (handled) return false;
  }
  if (!view->onPop()) return false;
  view->_c->closePopups();
  const auto found = std::find(pages.begin(), pages.end(), view);
  if (found != pages.begin() && found != pages.end()) uncovered = *std::prev(found);
  workLater();
  return true;
}

void WNaviframeController::NaviPrivate::workLater() {
  if (!later) later = ecore_job_add(laterCb, this);
}

void WNaviframeController::NaviPrivate::work() {
  WContentViewController* view = std::exchange(uncovered, nullptr);
  if (view && view->_c->item == elm_naviframe_top_item_get(self->getEvasObj())) view->onBecomeTop();
  if (arriving || pendingPops == 0) return;
  pendingPops--;
  elm_naviframe_item_pop(self->getEvasObj());
  if (pendingPops > 0) workLater();
}

Eina_Bool WNaviframeController::NaviPrivate::popCb(void* data, Elm_Object_Item* item) {
  auto* view = static_cast<WContentViewController*>(data);
  return view->_c->naviframe->_n->allowPop(view, item);
}

void WNaviframeController::NaviPrivate::itemDeletedCb(void* data, Evas_Object*, void*) {
  auto* view = static_cast<WContentViewController*>(data);
  view->_c->naviframe->_n->remove(view);
}

/// Popping from here would pull the item away under the toolkit.
void WNaviframeController::NaviPrivate::arrivedCb(void* data, Evas_Object*, void* item) {
  auto* self = static_cast<NaviPrivate*>(data);
  if (item != self->arriving) return;
  self->arriving = nullptr;
  if (self->pendingPops > 0) self->workLater();
}

void WNaviframeController::NaviPrivate::laterCb(void* data) {
  auto* self = static_cast<NaviPrivate*>(data);
  self->later = nullptr;
  self->work();
}

}  // namespace app_assist
