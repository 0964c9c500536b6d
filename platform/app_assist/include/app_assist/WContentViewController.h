#pragma once

#include "app_assist/WViewController.h"

namespace app_assist {

class WNaviframeController;
class WPopupController;

/// One page of the naviframe. The naviframe owns it from push() on and destroys it after it was
/// popped, never inside the handler that asked for the pop.
class WContentViewController : public WViewController {
 public:
  WContentViewController();
  ~WContentViewController() override;

  virtual void onSetContainerProperties();
  /// Pushes the naviframe item and returns it. By default: title, no buttons, the view object and
  /// the item style that was given to push().
  virtual Elm_Object_Item* onPushToNaviframe(Evas_Object* naviframe);
  /// The item is on the naviframe: add its buttons and title here.
  virtual void onPushed(Elm_Object_Item* item);
  /// About to be popped, by the user or by the program; false refuses.
  virtual bool onPop();
  /// The page above was popped: this one is the top again.
  virtual void onBecomeTop();
  virtual void onSetAsPageContent();
  virtual void onSetMoreButton();

  /// A message id or plain text; copied. Also sets it on the item when there is one already.
  void setTitle(const char* title);
  /// Never null.
  const char* getTitle() const;

  /// Null before the push.
  WNaviframeController* getNaviframe() const;
  Elm_Object_Item* getNaviItem() const;
  /// The item style given to push(), never null.
  const char* getItemStyle() const;

  /// Shows the popup above this page and takes ownership; it closes with the page. Allowed while
  /// another one is still closing.
  void attachPopup(WPopupController* popup);

 private:
  friend class WNaviframeController;
  friend class WPopupController;
  struct Private;
  std::unique_ptr<Private> _c;
};

}  // namespace app_assist
