#pragma once

#include <Elementary.h>

#include "companion/Row.h"

namespace companion {

/// The widgets of one row while it is in sight. The list owns them and may take them away at any
/// time; the view then does nothing.
class RowView {
 public:
  RowView(Evas_Object* list, const Row& row);
  ~RowView();
  RowView(const RowView&) = delete;
  RowView& operator=(const RowView&) = delete;

  /// Null when the list has taken it away.
  Evas_Object* object() const { return _layout; }

  /// Texts and progress; the row has the same widgets as before.
  void update(const Row& row);

 private:
  static void _deletedCb(void* data, Evas* canvas, Evas_Object* layout, void* info);
  void _put(const char* part, Evas_Object* content);
  Evas_Object* _makeActions(const Row& row);

  Evas_Object* _layout;
  Evas_Object* _progress = nullptr;  // the layout's
};

}  // namespace companion
