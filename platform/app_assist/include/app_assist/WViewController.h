#pragma once

#include <Elementary.h>

#include <memory>

namespace app_assist {

class WWindowController;

/// What has a view object: its creation and its end. The order of the virtual operations is part of
/// the interface.
class WViewController {
 public:
  virtual const char* getClassName();
  /// Builds the view: onPrepare, onCreateView, onCreated. False when there is no view object.
  virtual bool create(Evas_Object* parent, void* viewParam);
  /// Deletes the view object; the controller itself stays.
  virtual void destroy();
  /// False refuses the creation.
  virtual bool onPrepare();
  /// Returns the view object, a child of `parent`; null fails the creation. `viewParam` is what the
  /// pusher gave along, may be null.
  virtual Evas_Object* onCreateView(Evas_Object* parent, void* viewParam);
  /// The view object exists now: fill it.
  virtual void onCreated();
  /// The view object is going away, for whatever reason; returns its argument.
  virtual Evas_Object* onViewDeleted(Evas_Object* view);
  virtual ~WViewController();

  WViewController(const WViewController&) = delete;
  WViewController& operator=(const WViewController&) = delete;

  /// The view object; null before its creation and after its deletion.
  Evas_Object* getEvasObj() const;
  /// The controller of the window that shows the view, null while it is in none.
  WWindowController* getWindowController() const;

 protected:
  WViewController();

 private:
  friend class WNaviframeController;
  friend class WWindowController;
  friend class WContentViewController;
  friend class WPopupController;
  struct Private;
  std::unique_ptr<Private> _v;
};

}  // namespace app_assist
