/// Pages of a horizontal gengrid that shows one cell at a time, counted in the reading direction.
#pragma once

#include <Elementary.h>

/// Makes every cell as large as the pager. False while the pager has no size.
bool zqvFitPages(Evas_Object* pager);
int zqvPageOnScreen(Evas_Object* pager);
/// At once, not as a movement; also before the first layout, when the toolkit would take any cell
/// for the first.
void zqvShowPage(Evas_Object* pager, int page);
