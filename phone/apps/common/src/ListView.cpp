#include "companion/ListView.h"

#include <cstring>

#include "companion/Text.h"
#include "companion/Widgets.h"

namespace companion {
namespace {

constexpr const char* kTitle = "companion.title";
constexpr const char* kIcon = "companion.icon";
constexpr const char* kEnd = "companion.end";
constexpr const char* kProgress = "companion.progress";
constexpr const char* kActions = "companion.actions";

// The plain text button of the device theme.
constexpr const char* kActionStyle = "naviframe/title_left";

bool haveSameWidgets(const Row& left, const Row& right) {
  if (left.icon != right.icon || left.checked != right.checked ||
      left.progress.has_value() != right.progress.has_value() ||
      left.actions.size() != right.actions.size()) {
    return false;
  }
  for (std::size_t i = 0; i < left.actions.size(); i++) {
    if (left.actions[i].label != right.actions[i].label) return false;
  }
  return true;
}

}  // namespace

struct ListView::Cell {
  ListView* view;
  RowKey key;
  Row row;
  Elm_Object_Item* item = nullptr;
  Evas_Object* progress = nullptr;  // nulled by the toolkit when the row goes out of sight
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
  itemClass->func.text_get = _textGetCb;
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
  const bool sameTexts = cell.row.title == row.title && cell.row.detail == row.detail;
  cell.row = std::move(row);
  if (!sameWidgets) {
    elm_genlist_item_update(cell.item);
  } else if (!sameTexts) {
    elm_genlist_item_fields_update(cell.item, "companion.*", ELM_GENLIST_ITEM_FIELD_TEXT);
  }
  if (cell.progress) elm_progressbar_value_set(cell.progress, cell.row.progress.value_or(0));
  if (!sameTexts) _name(cell);
}

void ListView::_name(const Cell& cell) {
  setAccessibleName(cell.item, cell.row.detail.empty() ? cell.row.title
                                                       : cell.row.title + ", " + cell.row.detail);
}

char* ListView::_textGetCb(void* data, Evas_Object*, const char* part) {
  const Row& row = static_cast<Cell*>(data)->row;
  return strdup(escape(std::strcmp(part, kTitle) == 0 ? row.title : row.detail).c_str());
}

Evas_Object* ListView::_contentGetCb(void* data, Evas_Object*, const char* part) {
  auto* cell = static_cast<Cell*>(data);
  return cell->view->_content(*cell, part);
}

Evas_Object* ListView::_content(Cell& cell, const char* part) {
  const Row& row = cell.row;
  if (std::strcmp(part, kIcon) == 0) {
    return row.icon.empty() ? nullptr : makeIcon(_list, row.icon);
  }
  if (std::strcmp(part, kEnd) == 0) {
    return row.checked ? makeCheck(_list, *row.checked, row.title) : nullptr;
  }
  if (std::strcmp(part, kProgress) == 0) {
    if (!row.progress) return nullptr;
    Evas_Object* bar = makeProgress(_list, *row.progress);
    evas_object_event_callback_add(
        bar, EVAS_CALLBACK_DEL,
        [](void* slot, Evas*, Evas_Object* gone, void*) {
          auto& held = static_cast<Cell*>(slot)->progress;
          if (held == gone) held = nullptr;
        },
        &cell);
    cell.progress = bar;
    return bar;
  }
  if (std::strcmp(part, kActions) != 0 || row.actions.empty()) return nullptr;
  Evas_Object* box = elm_box_add(_list);
  elm_box_horizontal_set(box, EINA_TRUE);
  elm_box_padding_set(box, ELM_SCALE_SIZE(16), 0);
  elm_box_align_set(box, 0.0, 0.5);
  for (const auto& action : row.actions) {
    elm_box_pack_end(box, makeButton(box, kActionStyle, action.label, action.run,
                                     action.label + " " + row.title));
  }
  return box;
}

void ListView::_selectedCb(void* data, Evas_Object*, void* item) {
  auto* cell = static_cast<Cell*>(data);
  elm_genlist_item_selected_set(static_cast<Elm_Object_Item*>(item), EINA_FALSE);
  const RowKey key = cell->key;
  cell->view->_onTap(key);
}

}  // namespace companion
