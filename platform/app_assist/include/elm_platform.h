/// What the platform's toolkit has beyond the one of a desktop.
#pragma once

#include <Elementary.h>

#ifdef __cplusplus
extern "C" {
#endif

/// On the platform: realises every row of the list at once, so that its height follows its rows.
/// Here the rows in sight are always realised, and the lists this is asked for are in sight whole:
/// does nothing.
void elm_genlist_realization_mode_set(Evas_Object* list, Eina_Bool mode);

#ifdef __cplusplus
}
#endif
