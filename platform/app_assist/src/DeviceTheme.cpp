#include "DeviceTheme.h"

#include <Ecore_X.h>
#include <Elementary.h>
#include <dlog.h>

#include <base/PhonePaths.h>
#include <common/Owned.h>
#include <settings/Look.h>

#include <cstdio>
#include <cstdlib>

namespace app_assist {
namespace {

constexpr double kDesignScale = 2.6;
constexpr double kDesignWidth = 720;
/// Titles keep their size, or they would not fit.
constexpr const char* kScaledTexts[] = {"caption", "body", "label"};

std::string themeData(const std::string& key) {
  const common::OwnedPlainText value(edje_file_data_get(DeviceTheme::path().c_str(), key.c_str()));
  return value ? value.get() : "";
}

void setColour(const char* name, const char* palette) {
  const std::string value = themeData(std::string(palette) + "/" + name);
  int r = 0, g = 0, b = 0, a = 0;
  if (sscanf(value.c_str(), "%d %d %d %d", &r, &g, &b, &a) != 4) {
    dlog_print(DLOG_ERROR, "APP_ASSIST", "palette %s has no colour %s", palette, name);
    return;
  }
  edje_color_class_set(name, r, g, b, a, 0, 0, 0, 0, 0, 0, 0, 0);
}

void setTextSize(int percent) {
  for (const char* name : kScaledTexts) edje_text_class_set(name, nullptr, -percent);
}

/// Whoever uses the keyboard sees where it is; a touch hides that again.
void followKeyboard() {
  elm_config_window_auto_focus_enable_set(EINA_TRUE);
  elm_config_first_item_focus_on_first_focusin_set(EINA_TRUE);
}

}  // namespace

std::string DeviceTheme::path() {
  const char* given = getenv("APP_ASSIST_THEME");
  return given && *given ? given : base::phoneRoot() + "/share/theme/device.edj";
}

bool DeviceTheme::install() {
  const std::string file = path();
  if (!edje_file_group_exists(file.c_str(), "elm/layout/phone/window")) {
    dlog_print(DLOG_ERROR, "APP_ASSIST", "no device theme in %s", file.c_str());
    return false;
  }
  elm_theme_overlay_add(nullptr, file.c_str());
  applyScale();
  applyPalette();
  followKeyboard();
  return true;
}

void DeviceTheme::applyPalette() {
  const char* palette = settings::isDark() ? "dark" : "light";
  const std::string names = themeData("colours");
  const common::OwnedTexts list(g_strsplit(names.c_str(), " ", -1));
  for (char** name = list.get(); *name; name++) {
    if (**name) setColour(*name, palette);
  }
  // The toolkit takes the colours of a text's style up again only with a new size.
  setTextSize(settings::textSize() + 1);
  applyTextSize();
}

void DeviceTheme::applyTextSize() {
  setTextSize(settings::textSize());
}

void DeviceTheme::applyScale() {
  int count = 0;
  const common::Owned<Ecore_X_Window, free> roots(ecore_x_window_root_list(&count));
  int width = 0, height = 0;
  if (count > 0) ecore_x_window_size_get(roots.get()[0], &width, &height);
  elm_config_scale_set(width > 0 ? kDesignScale * width / kDesignWidth : kDesignScale);
}

}  // namespace app_assist
