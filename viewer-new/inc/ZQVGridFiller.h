#pragma once

#include <Eina.h>

#include <functional>

#include "ZQVTimer.h"

class ZQViewerThumbnailItem;

/// Puts a list of items into a grid: up to 19 at once, more in batches, so that the page shows
/// before the whole list is in the grid.
class ZQVGridFiller {
 public:
  using Append = std::function<void(ZQViewerThumbnailItem* item)>;

  /// `items` is borrowed and must stay until the filling has ended or this object is gone. Null
  /// entries are skipped.
  void start(Eina_List* items, Append append);
  void stop() { _timer.stop(); }
  bool isRunning() const { return _timer.isRunning(); }

 private:
  bool _appendBatch();
  void _appendRange(int first, int last);

  Eina_List* _items = nullptr;
  Append _append;
  int _next = 0;
  ZQVTimer _timer;
};
