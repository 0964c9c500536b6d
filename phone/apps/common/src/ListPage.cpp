#include "companion/ListPage.h"

#include <glib.h>

#include "companion/CompanionApp.h"
#include "companion/Text.h"
#include "companion/Widgets.h"

namespace companion {
namespace {

constexpr int kButtonGap = 32;  // pixels at scale 2.6
constexpr int kButtonWidth = 300;
constexpr int kButtonHeight = 104;

int scaled(int pixels) {
  return static_cast<int>(pixels * elm_config_scale_get() / 2.6);
}

}  // namespace

ListPage::ListPage() = default;

ListPage::~ListPage() = default;

Evas_Object* ListPage::onCreateView(Evas_Object* parent, void*) {
  _layout = elm_layout_add(parent);
  if (!elm_layout_file_set(_layout, themeFile().c_str(), "companion/page")) {
    g_warning("%s has no page", themeFile().c_str());
  }
  _list = std::make_unique<ListView>(
      _layout, [this](RowKey key) { return row(key); }, [this](RowKey key) { onRowTapped(key); });
  elm_object_part_content_set(_layout, "list", _list->object());
  _progress = makeProgress(_layout, 0);
  elm_object_part_content_set(_layout, "progress", _progress);
  evas_object_smart_callback_add(_layout, "language,changed", _languageChangedCb, this);
  showTexts();
  return _layout;
}

Evas_Object* ListPage::onViewDeleted(Evas_Object* view) {
  _layout = nullptr;
  _back = nullptr;
  _progress = nullptr;
  _buttons.clear();
  return view;
}

void ListPage::_languageChangedCb(void* data, Evas_Object*, void*) {
  auto* page = static_cast<ListPage*>(data);
  page->showTexts();
  setAccessibleName(page->_back, text("Back"));
  std::size_t i = 0;
  for (const auto& button : page->buttons()) setLabel(page->_buttons[i++], button.label);
  page->updateRows();
}

Elm_Object_Item* ListPage::onPushToNaviframe(Evas_Object* naviframe) {
  if (hasBackButton()) {
    _back = makeButton(
        naviframe, "naviframe/end_btn/default", "", [this] { getNaviframe()->pop(); },
        text("Back"));
  }
  return elm_naviframe_item_push(naviframe, escape(getTitle()).c_str(), _back, nullptr,
                                 getEvasObj(), getItemStyle());
}

void ListPage::onPushed(Elm_Object_Item* item) {
  const auto wanted = buttons();
  if (wanted.empty()) return;
  Evas_Object* box = elm_box_add(_layout);
  elm_box_horizontal_set(box, EINA_TRUE);
  elm_box_padding_set(box, scaled(kButtonGap), 0);
  for (const auto& button : wanted) {
    Evas_Object* widget = makeButton(box, "bottom", button.label, button.run);
    evas_object_size_hint_min_set(widget, scaled(kButtonWidth), scaled(kButtonHeight));
    elm_box_pack_end(box, widget);
    _buttons.push_back(widget);
  }
  elm_object_item_part_content_set(item, "toolbar", box);
}

std::vector<ListPage::Button> ListPage::buttons() {
  return {};
}

void ListPage::onRowTapped(RowKey) {}

void ListPage::_show(const char* part, bool shown) {
  const std::string signal = std::string(part) + (shown ? ",show" : ",hide");
  elm_layout_signal_emit(_layout, signal.c_str(), "companion");
}

void ListPage::setRows(const std::vector<RowKey>& keys) {
  if (!_layout) return;
  _list->setRows(keys);
  _isEmpty = keys.empty();
  _show("empty", _isEmpty);
  _describe();
}

void ListPage::updateRow(RowKey key) {
  if (_layout) _list->update(key);
}

void ListPage::updateRows() {
  if (_layout) _list->updateAll();
}

void ListPage::setHeader(const std::string& summary, std::optional<double> progress) {
  if (!_layout) return;
  _summary = summary;
  elm_layout_text_set(_layout, "header", escape(summary).c_str());
  _show("header", !summary.empty());
  _show("progress", progress.has_value());
  elm_progressbar_value_set(_progress, progress.value_or(0));
  setAccessibleName(_progress, format("Progress: %s", summary.c_str()));
  _describe();
}

void ListPage::setEmptyText(const std::string& emptyText) {
  if (!_layout) return;
  _emptyText = emptyText;
  elm_layout_text_set(_layout, "empty", escape(emptyText).c_str());
  _describe();
}

// Screen readers see widgets only, and these texts are none.
void ListPage::_describe() {
  setAccessibleName(_layout, _summary.empty() && _isEmpty ? _emptyText : _summary);
}

void ListPage::setButtonEnabled(std::size_t index, bool enabled) {
  if (index < _buttons.size()) elm_object_disabled_set(_buttons[index], !enabled);
}

}  // namespace companion
