#include "elm_platform.h"

void elm_genlist_realization_mode_set(Evas_Object*, Eina_Bool) {}
