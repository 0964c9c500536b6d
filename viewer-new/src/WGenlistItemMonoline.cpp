#include "WGenlistItemMonoline.h"

#include "ZQVRows.h"

WGenlistItemMonoline::WGenlistItemMonoline(const char* text) {
  setText(text);
}

WGenlistItemMonoline::~WGenlistItemMonoline() = default;

Elm_Genlist_Item_Class* WGenlistItemMonoline::getItemClass() {
  static Elm_Genlist_Item_Class rowClass = zqvRowClass("1line", _textCb, nullptr);
  return &rowClass;
}

const char* WGenlistItemMonoline::getClassName() {
  return "WGenlistItemMonoline";
}

void* WGenlistItemMonoline::onWrap(void* content) {
  return content;
}

void WGenlistItemMonoline::setText(const char* text) {
  _text.reset(g_strdup(text));
}

char* WGenlistItemMonoline::_textCb(void* data, Evas_Object*, const char* part) {
  if (!data || !zqvIsOneOf(part, {"elm.text.main.left", "elm.text.main", "elm.text"})) {
    return nullptr;
  }
  return zqvRowText(zqvRowOf<WGenlistItemMonoline>(data)->_text.get());
}
