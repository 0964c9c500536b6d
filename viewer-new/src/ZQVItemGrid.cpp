#include "ZQVItemGrid.h"

#include <glib.h>

#include "ZQVAccess.h"
#include "ZQVGridMetrics.h"

namespace {

constexpr const char* kViewType = "ViewType";

}  // namespace

ZQVItemGrid::~ZQVItemGrid() {
  if (!_grid) return;
  evas_object_event_callback_del_full(_grid, EVAS_CALLBACK_DEL, _deletedCb, this);
  _release();
}

Evas_Object* ZQVItemGrid::createVertical(Evas_Object* parent, const char* style) {
  create(parent);
  if (style) elm_object_style_set(_grid, style);
  evas_object_size_hint_weight_set(_grid, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  elm_gengrid_align_set(_grid, 0.0, 0.0);
  elm_gengrid_horizontal_set(_grid, EINA_FALSE);
  elm_gengrid_multi_select_set(_grid, EINA_TRUE);
  elm_scroller_policy_set(_grid, ELM_SCROLLER_POLICY_OFF, ELM_SCROLLER_POLICY_AUTO);
  fitCells(elm_object_top_widget_get(parent));
  evas_object_show(_grid);
  return _grid;
}

Evas_Object* ZQVItemGrid::create(Evas_Object* parent) {
  _grid = elm_gengrid_add(parent);
  evas_object_data_set(_grid, kViewType, GINT_TO_POINTER(_viewType));
  evas_object_event_callback_add(_grid, EVAS_CALLBACK_DEL, _deletedCb, this);
  return _grid;
}

void ZQVItemGrid::fitCells(Evas_Object* window) {
  if (!_grid) return;
  const int side = zqvGridCellSide(window);
  elm_gengrid_item_size_set(_grid, side, side);
}

Elm_Object_Item* ZQVItemGrid::append(ZQViewerThumbnailItem* item, Evas_Smart_Cb selected,
                                     void* data) {
  Elm_Object_Item* cell =
      elm_gengrid_item_append(_grid, item->getItemClass(), item, selected, data);
  item->gridItems[_viewType] = cell;
  zqvSetAccessibleName(cell, zqvCellName(*item));
  return cell;
}

void ZQVItemGrid::keepFocusAway(bool isAway) {
  if (_grid) elm_object_focus_allow_set(_grid, !isAway);
}

void ZQVItemGrid::nameCells() {
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    const auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (item) zqvSetAccessibleName(item->gridItems[_viewType], zqvCellName(*item));
  }
}

void ZQVItemGrid::forgetCells() {
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    if (data) static_cast<ZQViewerThumbnailItem*>(data)->gridItems[_viewType] = nullptr;
  }
}

int ZQVItemGrid::viewTypeOf(Evas_Object* grid) {
  return GPOINTER_TO_INT(grid ? evas_object_data_get(grid, kViewType) : nullptr);
}

void ZQVItemGrid::resetViewType(Evas_Object* grid) {
  evas_object_data_set(grid, kViewType, nullptr);
}

void ZQVItemGrid::_deletedCb(void* data, Evas*, Evas_Object*, void*) {
  static_cast<ZQVItemGrid*>(data)->_release();
}

void ZQVItemGrid::_release() {
  evas_object_data_del(_grid, kViewType);
  forgetCells();
  _grid = nullptr;
}
