#include "RowView.h"

#include <string>

#include "companion/CompanionApp.h"
#include "companion/Text.h"
#include "companion/Widgets.h"

namespace companion {
namespace {

// The plain text button of the device theme.
constexpr const char* kActionStyle = "naviframe/title_left";

}  // namespace

RowView::RowView(Evas_Object* list, const Row& row) : _layout(elm_layout_add(list)) {
  elm_layout_file_set(_layout, themeFile().c_str(), "companion/row");
  evas_object_event_callback_add(_layout, EVAS_CALLBACK_DEL, _deletedCb, this);
  if (!row.icon.empty()) _put("icon", makeIcon(_layout, row.icon));
  if (row.checked) _put("end", makeCheck(_layout, *row.checked, row.title));
  if (row.progress) {
    _progress = makeProgress(_layout, *row.progress);
    setAccessibleName(_progress, format("Progress: %s", row.title.c_str()));
    _put("progress", _progress);
  }
  if (!row.actions.empty()) _put("actions", _makeActions(row));
  update(row);
  evas_object_show(_layout);
}

RowView::~RowView() {
  if (_layout) evas_object_event_callback_del_full(_layout, EVAS_CALLBACK_DEL, _deletedCb, this);
}

void RowView::_deletedCb(void* data, Evas*, Evas_Object*, void*) {
  auto* view = static_cast<RowView*>(data);
  view->_layout = nullptr;
  view->_progress = nullptr;
}

void RowView::_put(const char* part, Evas_Object* content) {
  elm_object_part_content_set(_layout, part, content);
  elm_layout_signal_emit(_layout, (std::string(part) + ",show").c_str(), "companion");
}

Evas_Object* RowView::_makeActions(const Row& row) {
  Evas_Object* box = elm_box_add(_layout);
  elm_box_horizontal_set(box, EINA_TRUE);
  elm_box_align_set(box, 0.0, 0.5);
  for (const auto& action : row.actions) {
    elm_box_pack_end(box, makeButton(box, kActionStyle, action.label, action.run,
                                     action.label + " " + row.title));
  }
  evas_object_show(box);
  return box;
}

void RowView::update(const Row& row) {
  if (!_layout) return;
  elm_layout_text_set(_layout, "title", escape(row.title).c_str());
  elm_layout_text_set(_layout, "detail", escape(row.detail).c_str());
  if (_progress) elm_progressbar_value_set(_progress, row.progress.value_or(0));
  // The list asks for the smallest size before the next frame.
  edje_object_message_signal_process(elm_layout_edje_get(_layout));
  elm_layout_sizing_eval(_layout);
}

}  // namespace companion
