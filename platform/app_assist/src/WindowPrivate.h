#pragma once

#include <string>
#include <vector>

#include "Orientation.h"
#include "StatusStrip.h"
#include "app_assist/WViewController.h"
#include "app_assist/WWindowController.h"

namespace app_assist {

class WPopupController;

struct WWindowController::Private {
  Private(WWindowController* self, const char* name, Elm_Win_Type type)
      : self(self), name(name ? name : ""), type(type) {}

  WWindowController* const self;
  const std::string name;
  const Elm_Win_Type type;
  Evas_Object* window = nullptr;
  Evas_Object* frame = nullptr;
  std::unique_ptr<WViewController> base;
  /// Open ones, the uppermost last.
  std::vector<WPopupController*> popups;
  std::unique_ptr<StatusStrip> strip;
  std::unique_ptr<Orientation> orientation;

  void open();
  void close();
  void showBase();
  void rotate(int degrees);
  void back();
  bool hasForeignPopup() const;

  static void keyDownCb(void* data, Evas*, Evas_Object*, void* event);
  static void closeRequestCb(void* data, Evas_Object*, void*);
  static void windowDeletedCb(void* data, Evas*, Evas_Object*, void*);
};

}  // namespace app_assist
