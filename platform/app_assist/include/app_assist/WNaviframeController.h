#pragma once

#include <functional>

#include "app_assist/WViewController.h"

namespace app_assist {

class WContentViewController;

/// The stack of pages. Each naviframe item carries its WContentViewController as item data.
class WNaviframeController : public WViewController {
 public:
  WNaviframeController();
  ~WNaviframeController() override;

  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;

  /// Creates the view with `viewParam` and pushes it; takes ownership. `itemStyle` selects the item
  /// style of the device theme, null the default one. A view that cannot be created is destroyed.
  void push(WContentViewController* view, void* viewParam = nullptr,
            const char* itemStyle = nullptr);

  /// Pops the top page, as the back key does. During a push transition the page is popped as soon
  /// as the transition is over.
  void pop();

  /// Destroys every page at once, without transition and without asking onPop or the last-item-pop
  /// handler. Complete when it returns.
  void destroyAllViewControllers();

  /// Called when the last page is to be popped; setting `*handled` to true keeps the page standing.
  void setOnLastItemPop(std::function<void(bool* handled)> handler);

 private:
  friend class WContentViewController;
  struct NaviPrivate;
  std::unique_ptr<NaviPrivate> _n;
};

}  // namespace app_assist
