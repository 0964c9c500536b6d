#include "WGenlistItemMonoline1Check.h"

#include "ZQVRows.h"

namespace {

constexpr const char* kCheckPart = "elm.icon.2";
constexpr const char* kContent = "elm.swallow.content";

}  // namespace

WGenlistItemMonoline1Check::WGenlistItemMonoline1Check(const char* text) : _text(g_strdup(text)) {}

WGenlistItemMonoline1Check::~WGenlistItemMonoline1Check() = default;

Elm_Genlist_Item_Class* WGenlistItemMonoline1Check::getItemClass() {
  static Elm_Genlist_Item_Class rowClass = zqvRowClass("1line", _textCb, _contentCb);
  return &rowClass;
}

void WGenlistItemMonoline1Check::setChecked(bool checked) {
  Evas_Object* check = _findCheck();
  if (check) {
    elm_object_signal_emit(check, checked ? "elm,activate,check,on" : "elm,activate,check,off",
                           "elm");
    elm_check_state_set(check, checked);
  }
  _checked = checked;
}

void WGenlistItemMonoline1Check::_checkChangedCb(void* data, Evas_Object* check, void*) {
  if (!data) return;
  auto* row = static_cast<WGenlistItemMonoline1Check*>(data);
  elm_check_state_set(check, !elm_check_state_get(check));
  elm_genlist_item_selected_set(row->getElmObjectItem(), EINA_TRUE);
}

char* WGenlistItemMonoline1Check::_textCb(void* data, Evas_Object*, const char* part) {
  if (!data || !zqvIsOneOf(part, {"elm.text.main.left", "elm.text.main"})) return nullptr;
  return zqvRowText(zqvRowOf<WGenlistItemMonoline1Check>(data)->_text.get());
}

Evas_Object* WGenlistItemMonoline1Check::_contentCb(void* data, Evas_Object* list,
                                                    const char* part) {
  if (!zqvIsOneOf(part, {kCheckPart})) return nullptr;
  Evas_Object* layout = elm_layout_add(list);
  elm_layout_theme_set(layout, "layout", "list/C/type.1", "default");
  if (data) {
    auto* row = zqvRowOf<WGenlistItemMonoline1Check>(data);
    elm_object_part_content_set(layout, kContent, row->_createCheck(layout));
  }
  return layout;
}

Evas_Object* WGenlistItemMonoline1Check::_createCheck(Evas_Object* parent) {
  Evas_Object* check = elm_check_add(parent);
  elm_object_style_set(check, "list");
  elm_check_state_pointer_set(check, &_checked);
  evas_object_size_hint_align_set(check, EVAS_HINT_FILL, EVAS_HINT_FILL);
  evas_object_size_hint_weight_set(check, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  evas_object_pass_events_set(check, EINA_TRUE);
  elm_object_focus_allow_set(check, EINA_FALSE);
  evas_object_propagate_events_set(check, EINA_FALSE);
  evas_object_smart_callback_add(check, "changed", _checkChangedCb, this);
  evas_object_show(check);
  return check;
}

Evas_Object* WGenlistItemMonoline1Check::_findCheck() const {
  Elm_Object_Item* item = getElmObjectItem();
  if (!item) return nullptr;
  Evas_Object* layout = elm_object_item_part_content_get(item, kCheckPart);
  if (!layout) layout = elm_object_item_part_content_get(item, "elm.icon.1");
  return layout ? elm_object_part_content_get(layout, kContent) : nullptr;
}
