#pragma once

#include <functional>

#include "app_assist/WViewController.h"

namespace app_assist {

/// A popup at the bottom of the screen; back closes it. Configure it, then attachPopup() it to a
/// page, with which it goes. It is destroyed after the handler that closed it has returned.
class WPopupController : public WViewController {
 public:
  /// Sets `*close` to true to close the popup; the popup may be gone when the handler returns.
  using ButtonHandler = std::function<void(bool* close)>;
  /// Builds the content as a child of the popup object.
  using ContentBuilder = std::function<Evas_Object*(Evas_Object* popup)>;

  WPopupController();
  ~WPopupController() override;

  /// Builds the popup from the properties below.
  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;

  /// Title, text and button texts are message ids of this domain.
  void setTextDomain(const char* domain);
  void setTitle(const char* id);
  void setContent(const char* id);
  void setContent(ContentBuilder builder);
  /// At most three, left to right: they become the parts "button1" to "button3".
  void addButton(const char* id, ButtonHandler handler);

  /// The popup slides out and takes no more presses; then it is destroyed, never inside the call.
  void close();

 private:
  friend class WContentViewController;
  struct PopupPrivate;
  std::unique_ptr<PopupPrivate> _p;
};

}  // namespace app_assist
