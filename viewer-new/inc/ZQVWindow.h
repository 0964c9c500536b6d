#pragma once

#include <app_assist.h>

#include <string>

#include "ZQVAccess.h"

/// The window that shows a view; null once the view has left it.
inline Evas_Object* zqvWindowOf(const app_assist::WViewController& view) {
  app_assist::WWindowController* window = view.getWindowController();
  return window ? window->getEvasObj() : nullptr;
}

/// Tells screen readers the title of a page that is on the naviframe. What they see as the page is
/// the layout around the view object.
inline void zqvNamePage(const app_assist::WViewController& view, const std::string& title) {
  zqvSetAccessibleName(elm_object_parent_widget_get(view.getEvasObj()), title);
}
