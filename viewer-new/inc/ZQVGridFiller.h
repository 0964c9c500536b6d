#pragma once

#include <Elementary.h>

#include <functional>

#include "ZQVTimer.h"

class ZQViewerThumbnailItem;
class ZQVItemGrid;

/// Puts a list of items into a grid: up to 19 at once, more in batches, so that the page shows
/// before the whole list is in the grid.
class ZQVGridFiller {
 public:
  using Append = std::function<void(ZQViewerThumbnailItem* item)>;
  using Filled = std::function<void()>;

  /// `items` is borrowed and must stay until the filling has ended or this object is gone. Null
  /// entries are skipped. `filled`, which may be null, is called after the last one.
  void start(Eina_List* items, Append append, Filled filled = nullptr);
  /// Fills this grid, which takes no focus meanwhile; `selected` is called with `data` when a cell
  /// is.
  void fill(ZQVItemGrid& grid, Eina_List* items, Evas_Smart_Cb selected, void* data);
  void stop() { _timer.stop(); }
  bool isRunning() const { return _timer.isRunning(); }

 private:
  bool _appendBatch();
  void _appendRange(int first, int last);

  Eina_List* _items = nullptr;
  Append _append;
  Filled _filled;
  int _next = 0;
  ZQVTimer _timer;
};
