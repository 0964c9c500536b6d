#pragma once

#include <Elementary.h>

#include "ZQVThumbItem.h"

/// A gengrid that shows shared files as one kind of grid. Whenever the gengrid goes away, for
/// whatever reason, the files forget the cells that they had in it.
class ZQVItemGrid {
 public:
  /// `items` is borrowed.
  ZQVItemGrid(Eina_List* items, ZQVViewType viewType) : _items(items), _viewType(viewType) {}
  ~ZQVItemGrid();
  ZQVItemGrid(const ZQVItemGrid&) = delete;
  ZQVItemGrid& operator=(const ZQVItemGrid&) = delete;

  /// Makes the gengrid a vertical one with square cells. `style` null is the default look.
  Evas_Object* createVertical(Evas_Object* parent, const char* style);
  /// Makes the gengrid without any layout of its own.
  Evas_Object* create(Evas_Object* parent);

  /// Square cells for the window's rotation; nothing without a gengrid.
  void fitCells(Evas_Object* window);
  /// Null when the gengrid took no cell.
  Elm_Object_Item* append(ZQViewerThumbnailItem* item, Evas_Smart_Cb selected, void* data);
  /// While cells come in batches the focus has to stay away: it would move on to the newest cell,
  /// and the grid would scroll after it.
  void keepFocusAway(bool isAway);
  /// Tells screen readers what the cells are, in the language of now.
  void nameCells();
  void forgetCells();

  /// The ZQVViewType of a gengrid; a grid that was reset, or null, has none.
  static int viewTypeOf(Evas_Object* grid);
  /// Makes a gengrid one of no type.
  static void resetViewType(Evas_Object* grid);

  Evas_Object* get() const { return _grid; }
  ZQVViewType getViewType() const { return _viewType; }

 private:
  static void _deletedCb(void* data, Evas* canvas, Evas_Object* grid, void* info);
  void _release();

  Eina_List* _items;
  ZQVViewType _viewType;
  Evas_Object* _grid = nullptr;
};
