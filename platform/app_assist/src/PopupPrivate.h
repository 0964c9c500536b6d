#pragma once

#include <memory>
#include <string>
#include <vector>

#include "app_assist/WPopupController.h"

namespace app_assist {

struct WPopupController::PopupPrivate {
  struct Button {
    WPopupController* popup;
    std::string id;
    ButtonHandler handler;
  };

  std::string domain;
  std::string title;
  std::string text;
  ContentBuilder builder;
  std::vector<std::unique_ptr<Button>> buttons;
  /// The page that it is attached to, null once it has ended.
  WContentViewController* page = nullptr;
  /// Attached and not yet closed.
  bool open = false;
  /// Outlives the popup in the hands of who has to know whether it is still there.
  std::shared_ptr<bool> alive = std::make_shared<bool>(true);

  void setText(Evas_Object* object, const char* part, const std::string& id) const;
  void addContent(Evas_Object* popup) const;
  void addButtons(Evas_Object* popup) const;
  void watchView(WPopupController* popup);
  static void stop(WPopupController* popup);
  /// At once, whether it is open or still sliding out.
  static void end(WPopupController* popup);

  static void clickedCb(void* data, Evas_Object*, void*);
  static void dismissedCb(void* data, Evas_Object*, void*);
  static void viewDeletedCb(void* data, Evas*, Evas_Object*, void*);
};

}  // namespace app_assist
