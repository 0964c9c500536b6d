#pragma once

#include <app_assist.h>

/// The window that shows a view; null once the view has left it.
inline Evas_Object* zqvWindowOf(const app_assist::WViewController& view) {
  app_assist::WWindowController* window = view.getWindowController();
  return window ? window->getEvasObj() : nullptr;
}
