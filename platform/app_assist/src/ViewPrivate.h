#pragma once

#include "app_assist/WViewController.h"

namespace app_assist {

struct WViewController::Private {
  Evas_Object* view = nullptr;
  WWindowController* window = nullptr;

  static void viewDeletedCb(void* data, Evas*, Evas_Object* view, void*);
};

}  // namespace app_assist
