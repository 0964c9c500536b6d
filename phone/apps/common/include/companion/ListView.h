#pragma once

#include <Elementary.h>

#include <functional>
#include <map>
#include <memory>
#include <vector>

#include "companion/Row.h"

namespace companion {

/// A list of rows that are asked for when they come into sight.
class ListView {
 public:
  using Source = std::function<Row(RowKey)>;
  using Handler = std::function<void(RowKey)>;

  /// The list is a child of `parent`, which owns it.
  ListView(Evas_Object* parent, Source source, Handler onTap);
  ~ListView();
  ListView(const ListView&) = delete;
  ListView& operator=(const ListView&) = delete;

  Evas_Object* object() const { return _list; }

  void setRows(const std::vector<RowKey>& keys);
  /// Asks for the row again: its buttons are made anew when they changed, else only texts and
  /// progress move.
  void update(RowKey key);
  void updateAll();

 private:
  struct Cell;

  static Evas_Object* _contentGetCb(void* data, Evas_Object* list, const char* part);
  static void _selectedCb(void* data, Evas_Object* list, void* item);
  static void _deletedCb(void* data, Evas* canvas, Evas_Object* list, void* info);

  Elm_Genlist_Item_Class* _makeClass();
  void _refresh(Cell& cell);
  void _name(const Cell& cell);

  Evas_Object* _list;
  Source _source;
  Handler _onTap;
  std::vector<RowKey> _keys;
  std::map<RowKey, std::unique_ptr<Cell>> _cells;
};

}  // namespace companion
