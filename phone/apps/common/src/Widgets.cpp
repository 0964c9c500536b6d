#include "companion/Widgets.h"

#include "companion/Text.h"

namespace companion {
namespace {

using Handler = std::function<void()>;

void clickedCb(void* data, Evas_Object*, void*) {
  const Handler handler = *static_cast<Handler*>(data);  // the button may go in its own handler
  handler();
}

void deletedCb(void* data, Evas*, Evas_Object*, void*) {
  delete static_cast<Handler*>(data);
}

}  // namespace

void setAccessibleName(Eo* object, const std::string& name) {
  if (object) efl_access_object_i18n_name_set(object, singleLine(name).c_str());
}

Evas_Object* makeButton(Evas_Object* parent, const char* style, const std::string& label,
                        Handler onClick, const std::string& name) {
  Evas_Object* button = elm_button_add(parent);
  elm_object_style_set(button, style);
  setLabel(button, label);
  if (!name.empty()) setAccessibleName(button, name);
  auto* handler = new Handler(std::move(onClick));
  evas_object_smart_callback_add(button, "clicked", clickedCb, handler);
  evas_object_event_callback_add(button, EVAS_CALLBACK_DEL, deletedCb, handler);
  evas_object_show(button);
  return button;
}

void setLabel(Evas_Object* button, const std::string& label) {
  elm_object_text_set(button, escape(label).c_str());
  setAccessibleName(button, label);
}

// Shows only: the row that holds it is what one taps.
Evas_Object* makeCheck(Evas_Object* parent, bool on, const std::string& name) {
  Evas_Object* check = elm_check_add(parent);
  elm_object_style_set(check, "list");
  elm_check_state_set(check, on);
  evas_object_pass_events_set(check, EINA_TRUE);
  setAccessibleName(check, name);
  evas_object_show(check);
  return check;
}

Evas_Object* makeProgress(Evas_Object* parent, double value) {
  Evas_Object* bar = elm_progressbar_add(parent);
  elm_progressbar_unit_format_set(bar, nullptr);
  elm_progressbar_value_set(bar, value);
  evas_object_show(bar);
  return bar;
}

Evas_Object* makeIcon(Evas_Object* parent, const std::string& path) {
  Evas_Object* image = elm_image_add(parent);
  elm_image_file_set(image, path.c_str(), nullptr);
  elm_image_aspect_fixed_set(image, EINA_TRUE);
  evas_object_show(image);
  return image;
}

}  // namespace companion
