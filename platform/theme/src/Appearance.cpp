#include "Appearance.h"

#include <Edje.h>
#include <common/Owned.h>
#include <settings/Look.h>
#include <vconf.h>

namespace theme {
namespace {

Style currentStyle() {
  return settings::isDark() ? Style::Dark : Style::Light;
}

bool setColour(Evas_Object* object, const std::string& code) {
  int r = 0, g = 0, b = 0, a = 0;
  if (!edje_color_class_get(code.c_str(), &r, &g, &b, &a, nullptr, nullptr, nullptr, nullptr,
                            nullptr, nullptr, nullptr, nullptr)) {
    return false;
  }
  evas_color_argb_premul(a, &r, &g, &b);
  evas_object_color_set(object, r, g, b, a);
  return true;
}

}  // namespace

Appearance& Appearance::instance() {
  static Appearance appearance;
  return appearance;
}

void Appearance::setChangeable(bool changeable) {
  _changeable = changeable;
  applyColours();
}

void Appearance::setColours(const ColourTable* table) {
  forget(_colours);
  _colours = table;
  follow();
  applyColours();
}

void Appearance::setFonts(const FontTable* table) {
  forget(_fonts);
  _fonts = table;
  follow();
  applyFonts();
}

void Appearance::forget(const ColourTable* table) {
  if (!table || _colours != table) return;
  _colours = nullptr;
  for (const Style style : {Style::Light, Style::Dark}) {
    for (const auto& entry : table->colours(style)) edje_color_class_del(entry.first.c_str());
  }
}

void Appearance::forget(const FontTable* table) {
  if (!table || _fonts != table) return;
  _fonts = nullptr;
  for (const auto& entry : table->fonts()) edje_text_class_del(entry.first.c_str());
}

bool Appearance::colourObject(Evas_Object* object, const std::string& code) {
  if (!setColour(object, code)) return false;
  if (_objects.find(object) == _objects.end()) {
    evas_object_event_callback_add(object, EVAS_CALLBACK_DEL, objectDeletedCb, this);
  }
  _objects[object] = code;
  return true;
}

void Appearance::objectDeletedCb(void* data, Evas*, Evas_Object* object, void*) {
  static_cast<Appearance*>(data)->_objects.erase(object);
}

void Appearance::follow() {
  if (_following) return;
  _following = true;
  vconf_notify_key_changed(
      settings::kThemeKey, [](keynode_t*, void*) { instance().applyColours(); }, nullptr);
  vconf_notify_key_changed(
      settings::kTextSizeKey, [](keynode_t*, void*) { instance().applyFonts(); }, nullptr);
}

void Appearance::applyColours() {
  if (!_colours) return;
  const Style style = _changeable ? currentStyle() : Style::Light;
  for (const auto& [code, colour] : _colours->colours(style)) {
    edje_color_class_set(code.c_str(), colour.r, colour.g, colour.b, colour.a, 0, 0, 0, 0, 0, 0, 0,
                         0);
  }
  for (const auto& [object, code] : _objects) setColour(object, code);
}

void Appearance::applyFonts() {
  if (!_fonts) return;
  for (const auto& [code, font] : _fonts->fonts()) {
    edje_text_class_set(code.c_str(), font.name.c_str(), font.size * settings::textSize() / 100);
  }
}

}  // namespace theme
