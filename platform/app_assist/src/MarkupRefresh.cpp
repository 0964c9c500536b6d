#include "MarkupRefresh.h"

#include <Elementary.h>

#include <cstring>
#include <regex>

#include "WidgetWalk.h"

namespace app_assist {
namespace {

bool currentValues(const std::string& code, TextClassValues* values) {
  const char* font = nullptr;
  int r = 0, g = 0, b = 0;
  if (!edje_text_class_get(code.c_str(), &font, &values->size) || values->size <= 0) return false;
  if (!edje_color_class_get(code.c_str(), &r, &g, &b, nullptr, nullptr, nullptr, nullptr, nullptr,
                            nullptr, nullptr, nullptr, nullptr)) {
    return false;
  }
  values->rgb =
      static_cast<unsigned>(r) << 16 | static_cast<unsigned>(g) << 8 | static_cast<unsigned>(b);
  return true;
}

std::string tags(const TextClassValues& values) {
  char text[64];
  snprintf(text, sizeof text, "<font_size=%d><color=#%06x>", values.size, values.rgb);
  return text;
}

void refreshLabel(Evas_Object* label) {
  const char* text = elm_object_text_get(label);
  if (!text || !strstr(text, "text_class=")) return;
  const std::string refreshed = refreshedMarkup(text, currentValues);
  if (refreshed != text) elm_object_text_set(label, refreshed.c_str());
}

bool refresh(Evas_Object* object, const char* type) {
  if (strcmp(type, "elm_label") == 0) {
    refreshLabel(object);
  } else if (strcmp(type, "elm_gengrid") == 0) {
    elm_gengrid_realized_items_update(object);
  } else if (strcmp(type, "elm_genlist") == 0) {
    elm_genlist_realized_items_update(object);
  } else {
    // Neither asks for the room of its larger text by itself.
    if (strcmp(type, "elm_button") == 0 || strcmp(type, "elm_check") == 0) {
      elm_layout_sizing_eval(object);
    }
    return true;
  }
  return false;
}

}  // namespace

std::string refreshedMarkup(const std::string& markup, const TextClassLookup& lookup) {
  static const std::regex pattern(
      "( text_class=([A-Za-z0-9]{1,32})>)<font_size=[0-9]{1,4}><color=#[0-9a-fA-F]{6}>");
  std::string result;
  auto rest = markup.cbegin();
  for (std::sregex_iterator match(markup.begin(), markup.end(), pattern), end; match != end;
       ++match) {
    TextClassValues values{};
    const bool known = lookup((*match)[2], &values);
    result.append(rest, (*match)[0].first);
    result.append(known ? (*match)[1].str() + tags(values) : match->str());
    rest = (*match)[0].second;
  }
  return result.append(rest, markup.cend());
}

void refreshTexts(Evas_Object* window) {
  walkWidgets(window, refresh);
}

}  // namespace app_assist
