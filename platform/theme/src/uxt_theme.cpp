#include "uxt_theme.h"

#include <tizen_error.h>

#include "CurrentTheme.h"

struct uxt_theme_color_table_s {
  std::unique_ptr<ColorTable> table;
};
struct uxt_theme_font_table_s {
  std::unique_ptr<FontTable> table;
};

void uxt_theme_set_changeable_ui_enabled(bool enabled) {
  CurrentTheme::get().changeable = enabled;
}

uxt_theme_color_table_h uxt_theme_add_color_table(const char* path) {
  auto table = ColorTable::read(path);
  return table ? new uxt_theme_color_table_s{std::move(table)} : nullptr;
}

uxt_theme_font_table_h uxt_theme_add_font_table(const char* path) {
  auto table = FontTable::read(path);
  return table ? new uxt_theme_font_table_s{std::move(table)} : nullptr;
}

int uxt_theme_set_color_table(uxt_theme_color_table_h table) {
  if (!table) return TIZEN_ERROR_INVALID_PARAMETER;
  CurrentTheme::get().colors = table->table.get();
  return TIZEN_ERROR_NONE;
}

int uxt_theme_set_font_table(uxt_theme_font_table_h table) {
  if (!table) return TIZEN_ERROR_INVALID_PARAMETER;
  CurrentTheme::get().fonts = table->table.get();
  return TIZEN_ERROR_NONE;
}

void uxt_theme_delete_color_table(uxt_theme_color_table_h table) {
  if (table && CurrentTheme::get().colors == table->table.get()) {
    CurrentTheme::get().colors = nullptr;
  }
  delete table;
}

void uxt_theme_delete_font_table(uxt_theme_font_table_h table) {
  if (table && CurrentTheme::get().fonts == table->table.get()) {
    CurrentTheme::get().fonts = nullptr;
  }
  delete table;
}
