#include "uxt_theme.h"

#include <base/Fault.h>
#include <tizen_error.h>

#include "Appearance.h"

using theme::Appearance;

struct uxt_theme_color_table_s {
  std::unique_ptr<theme::ColourTable> table;
};

struct uxt_theme_font_table_s {
  std::unique_ptr<theme::FontTable> table;
};

void uxt_theme_set_changeable_ui_enabled(bool enabled) {
  Appearance::instance().setChangeable(enabled);
}

uxt_theme_color_table_h uxt_theme_add_color_table(const char* path) {
  if (base::strikes(__func__)) return nullptr;
  auto table = theme::ColourTable::read(path);
  return table ? new uxt_theme_color_table_s{std::move(table)} : nullptr;
}

uxt_theme_font_table_h uxt_theme_add_font_table(const char* path) {
  if (base::strikes(__func__)) return nullptr;
  auto table = theme::FontTable::read(path);
  return table ? new uxt_theme_font_table_s{std::move(table)} : nullptr;
}

int uxt_theme_set_color_table(uxt_theme_color_table_h table) {
  if (base::strikes(__func__)) return TIZEN_ERROR_INVALID_PARAMETER;
  if (!table) return TIZEN_ERROR_INVALID_PARAMETER;
  Appearance::instance().setColours(table->table.get());
  return TIZEN_ERROR_NONE;
}

int uxt_theme_set_font_table(uxt_theme_font_table_h table) {
  if (base::strikes(__func__)) return TIZEN_ERROR_INVALID_PARAMETER;
  if (!table) return TIZEN_ERROR_INVALID_PARAMETER;
  Appearance::instance().setFonts(table->table.get());
  return TIZEN_ERROR_NONE;
}

void uxt_theme_delete_color_table(uxt_theme_color_table_h table) {
  if (table) Appearance::instance().forget(table->table.get());
  delete table;
}

void uxt_theme_delete_font_table(uxt_theme_font_table_h table) {
  if (table) Appearance::instance().forget(table->table.get());
  delete table;
}
