#pragma once

#include <app_assist.h>

#include <string>

#include "ZQVAccess.h"
#include "ZQVText.h"

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

/// Gives a widget that fills a page the pages' own background.
inline void zqvColorPage(Evas_Object* widget) {
  edje_object_color_class_set(elm_layout_edje_get(widget), "transparent", 229, 237, 240, 255, 0, 0,
                              0, 0, 0, 0, 0, 0);
}

/// The arrow in front of a page's title; the naviframe becomes its owner with the push.
inline Evas_Object* zqvAddBackButton(Evas_Object* naviframe, Evas_Smart_Cb clicked,
                                     const void* data) {
  Evas_Object* back = elm_button_add(naviframe);
  elm_object_style_set(back, "naviframe/end_btn/default");
  evas_object_smart_callback_add(back, "clicked", clicked, data);
  // Translated whenever a screen reader asks, as the language may change.
  efl_access_object_translation_domain_set(back, ZQV_TEXT_DOMAIN);
  zqvSetAccessibleName(back, "Back");
  return back;
}
