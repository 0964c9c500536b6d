/// An application's own tables of colours and fonts.
#pragma once

#include <stdbool.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct uxt_theme_color_table_s* uxt_theme_color_table_h;
typedef struct uxt_theme_font_table_s* uxt_theme_font_table_h;

/// Whether the tables follow the phone's light and dark theme; otherwise they stay light.
void uxt_theme_set_changeable_ui_enabled(bool enabled);

/// Reads a table; null, with a log line, when it cannot be read. The caller deletes it.
uxt_theme_color_table_h uxt_theme_add_color_table(const char* path);
uxt_theme_font_table_h uxt_theme_add_font_table(const char* path);

/// Makes the table's codes current: 0, or -22 for null.
int uxt_theme_set_color_table(uxt_theme_color_table_h table);
int uxt_theme_set_font_table(uxt_theme_font_table_h table);

/// Null is allowed. The codes of a table in force are unknown from then on.
void uxt_theme_delete_color_table(uxt_theme_color_table_h table);
void uxt_theme_delete_font_table(uxt_theme_font_table_h table);

#ifdef __cplusplus
}
#endif
