#pragma once

#include <vector>

#include "app_assist/WContentViewController.h"
#include "app_assist/WNaviframeController.h"

namespace app_assist {

struct WNaviframeController::NaviPrivate {
  explicit NaviPrivate(WNaviframeController* self) : self(self) {}
  ~NaviPrivate();

  WNaviframeController* const self;
  /// Bottom first, and those that are still sliding out.
  std::vector<WContentViewController*> pages;
  std::function<void(bool*)> onLastItemPop;
  /// The item that is sliding in; it cannot be popped before that is over.
  Elm_Object_Item* arriving = nullptr;
  /// Back presses that came while it was.
  int pendingPops = 0;
  /// The page that has to be told that it is the top again.
  WContentViewController* uncovered = nullptr;
  Ecore_Job* later = nullptr;

  bool add(WContentViewController* view, void* viewParam);
  void remove(WContentViewController* view);
  bool allowPop(WContentViewController* view, Elm_Object_Item* item);
  void workLater();
  void work();

  static Eina_Bool popCb(void* data, Elm_Object_Item* item);
  static void itemDeletedCb(void* data, Evas_Object*, void*);
  static void arrivedCb(void* data, Evas_Object*, void* item);
  static void laterCb(void* data);
};

}  // namespace app_assist
