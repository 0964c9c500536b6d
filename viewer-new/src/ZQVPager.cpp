#include "ZQVPager.h"

namespace {

// Places count from the left. A mirrored gengrid puts its first cell to the right, but whether the
// toolkit's own page numbers follow depends on when it was mirrored; places can be relied on.
int mirroredIfSo(Evas_Object* pager, int page) {
  const int last = static_cast<int>(elm_gengrid_items_count(pager)) - 1;
  return elm_object_mirrored_get(pager) ? last - page : page;
}

}  // namespace

bool zqvFitPages(Evas_Object* pager) {
  int width = 0;
  int height = 0;
  evas_object_geometry_get(pager, nullptr, nullptr, &width, &height);
  if (width <= 0 || height <= 0) return false;
  // To the left either way: when mirrored the toolkit takes the alignment from the other side, and
  // pages that begin left of 0 snap to their neighbours.
  elm_gengrid_align_set(pager, elm_object_mirrored_get(pager) ? 1.0 : 0.0, 0.0);
  elm_gengrid_item_size_set(pager, width, height);
  elm_scroller_page_size_set(pager, width, height);
  return true;
}

int zqvPageOnScreen(Evas_Object* pager) {
  int x = 0;
  int width = 0;
  elm_scroller_region_get(pager, &x, nullptr, nullptr, nullptr);
  elm_gengrid_item_size_get(pager, &width, nullptr);
  return width > 0 ? mirroredIfSo(pager, (x + width / 2) / width) : 0;
}

void zqvShowPage(Evas_Object* pager, int page) {
  int width = 0;
  int height = 0;
  elm_gengrid_item_size_get(pager, &width, &height);
  const int x = mirroredIfSo(pager, page) * width;
  elm_scroller_region_show(pager, x, 0, width, height);
  // Snapping allows one page beyond the one that was on screen at the last call by number; without
  // this a late layout would be held back near the page before.
  int number = 0;
  elm_scroller_current_page_get(pager, &number, nullptr);
  elm_scroller_page_show(pager, number, 0);
  // That call leaves a mirrored pager with a wish for the opposite page; the last wish counts.
  elm_scroller_region_show(pager, x, 0, width, height);
}
