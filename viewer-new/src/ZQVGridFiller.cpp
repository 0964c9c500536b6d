#include "ZQVGridFiller.h"

#include <algorithm>
#include <utility>

#include "ZQVItemGrid.h"
#include "ZQVThumbItem.h"

namespace {

constexpr int kMostAtOnce = 19;
constexpr int kBatchStep = 10;
constexpr double kBatchInterval = 0.01;

}  // namespace

void ZQVGridFiller::start(Eina_List* items, Append append, Filled filled) {
  stop();
  _items = items;
  _append = std::move(append);
  _filled = std::move(filled);
  _next = 0;
  const int count = static_cast<int>(eina_list_count(_items));
  if (count > kMostAtOnce) {
    _timer.start(kBatchInterval, [this] { return _appendBatch(); });
  } else {
    _appendRange(0, count - 1);
    if (_filled) _filled();
  }
}

void ZQVGridFiller::fill(ZQVItemGrid& grid, Eina_List* items, Evas_Smart_Cb selected, void* data) {
  grid.keepFocusAway(true);
  start(
      items,
      [&grid, selected, data](ZQViewerThumbnailItem* item) {
        if (grid.get()) grid.append(item, selected, data);
      },
      [&grid] { grid.keepFocusAway(false); });
}

bool ZQVGridFiller::_appendBatch() {
  const int last = static_cast<int>(eina_list_count(_items)) - 1;
  const int end = std::min(_next + kBatchStep, last);
  _appendRange(_next, end);
  _next = end + 1;
  if (_next <= last) return true;
  if (_filled) _filled();
  return false;
}

void ZQVGridFiller::_appendRange(int first, int last) {
  int position = 0;
  const Eina_List* node = nullptr;
  void* item = nullptr;
  EINA_LIST_FOREACH(_items, node, item) {
    if (position > last) return;
    if (item && position >= first) _append(static_cast<ZQViewerThumbnailItem*>(item));
    ++position;
  }
}
