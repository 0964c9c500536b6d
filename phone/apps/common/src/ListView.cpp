#include "companion/ListView.h"

#include "RowView.h"
#include "companion/Widgets.h"

namespace companion {
namespace {

bool haveSameWidgets(const Row& left, const Row& right) {
  if (left.icon != right.icon || left.checked != right.checked ||
      left.progress.has_value() != right.progress.has_value() ||
      left.actions.size() != right.actions.size()) {
    return false;
  }
  for (std::size_t i = 0; i < left.actions.size(); i++) {
    if (left.actions[i].label != right.actions[i].label) return false;
  }
  return left.title == right.title;  // the buttons are named after it
}

}  // namespace

struct ListView::Cell {
  ListView* list;
  RowKey key;
  Row row;
  Elm_Object_Item* item = nullptr;
  std::unique_ptr<RowView> view = nullptr;
};

ListView::ListView(Evas_Object* parent, Source source, Handler onTap)
    : _list(elm_genlist_add(parent)), _source(std::move(source)), _onTap(std::move(onTap)) {
  elm_genlist_mode_set(_list, ELM_LIST_COMPRESS);
  elm_genlist_select_mode_set(_list, ELM_OBJECT_SELECT_MODE_ALWAYS);
  elm_scroller_policy_set(_list, ELM_SCROLLER_POLICY_OFF, ELM_SCROLLER_POLICY_AUTO);
  evas_object_event_callback_add(_list, EVAS_CALLBACK_DEL, _deletedCb, this);
  evas_object_show(_list);
}

ListView::~ListView() {
  if (!_list) return;
  evas_object_event_callback_del_full(_list, EVAS_CALLBACK_DEL, _deletedCb, this);
  evas_object_del(_list);
}

void ListView::_deletedCb(void* data, Evas*, Evas_Object*, void*) {
  static_cast<ListView*>(data)->_list = nullptr;
}

Elm_Genlist_Item_Class* ListView::_makeClass() {
  Elm_Genlist_Item_Class* itemClass = elm_genlist_item_class_new();
  itemClass->item_style = "companion";
  itemClass->func.content_get = _contentGetCb;
  return itemClass;
}

void ListView::setRows(const std::vector<RowKey>& keys) {
  if (!_list) return;
  if (keys == _keys) {
    updateAll();
    return;
  }
  elm_genlist_clear(_list);
  _cells.clear();
  _keys = keys;
  Elm_Genlist_Item_Class* itemClass = _makeClass();
  for (const RowKey key : _keys) {
    auto& cell = _cells[key];
    cell = std::make_unique<Cell>(Cell{this, key, _source(key)});
    cell->item = elm_genlist_item_append(_list, itemClass, cell.get(), nullptr,
                                         ELM_GENLIST_ITEM_NONE, _selectedCb, cell.get());
    _name(*cell);
  }
  elm_genlist_item_class_free(itemClass);
}

void ListView::updateAll() {
  for (auto& [key, cell] : _cells) _refresh(*cell);
}

void ListView::update(RowKey key) {
  const auto found = _cells.find(key);
  if (_list && found != _cells.end()) _refresh(*found->second);
}

void ListView::_refresh(Cell& cell) {
  Row row = _source(cell.key);
  const bool sameWidgets = haveSameWidgets(cell.row, row);
  cell.row = std::move(row);
  if (!sameWidgets) {
    elm_genlist_item_update(cell.item);
  } else if (cell.view) {
    cell.view->update(cell.row);
  }
  _name(cell);
}

void ListView::_name(const Cell& cell) {
  setAccessibleName(cell.item, cell.row.detail.empty() ? cell.row.title
                                                       : cell.row.title + ", " + cell.row.detail);
}

Evas_Object* ListView::_contentGetCb(void* data, Evas_Object* list, const char*) {
  auto* cell = static_cast<Cell*>(data);
  cell->view = std::make_unique<RowView>(list, cell->row);
  return cell->view->object();
}

void ListView::_selectedCb(void* data, Evas_Object*, void* item) {
  auto* cell = static_cast<Cell*>(data);
  elm_genlist_item_selected_set(static_cast<Elm_Object_Item*>(item), EINA_FALSE);
  const RowKey key = cell->key;
  cell->list->_onTap(key);
}

}  // namespace companion
