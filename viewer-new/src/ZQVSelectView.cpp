#include "ZQVSelectView.h"

#include <system_settings.h>

#include "WGenlistItemMonoline1Check.h"
#include "ZQVAccess.h"
#include "ZQVCommon.h"
#include "ZQVDownloadMgr.h"
#include "ZQVDownloadRule.h"
#include "ZQVLog.h"
#include "ZQVOrlantLog.h"
#include "ZQVRows.h"
#include "ZQVText.h"
#include "ZQVWifiSelectPopup.h"
#include "ZQVWindow.h"

namespace {

constexpr const char* kTitle = "IDS_RSH_HEADER_SELECT_ITEMS_ABB3";
constexpr const char* kCountTitle = "IDS_RSH_HEADER_PD_SELECTED_ABB";
constexpr const char* kSelectAll = "IDS_RSH_OPT_SELECT_ALL";
constexpr const char* kDone = "IDS_TPLATFORM_ACBUTTON_DONE_ABB";
constexpr const char* kCancel = "IDS_TPLATFORM_ACBUTTON_CANCEL_ABB";
constexpr const char* kDonePart = "title_right_btn";
constexpr const char* kCancelPart = "title_left_btn";
constexpr const char* kCheckPart = "elm.swallow.end";

ZQViewerThumbnailItem* itemOf(Elm_Object_Item* cell) {
  return static_cast<ZQViewerThumbnailItem*>(elm_object_item_data_get(cell));
}

bool isSelectable(const ZQViewerThumbnailItem& item) {
  return item.downloadStatus == ZQV_NOT_DOWNLOADED || item.downloadStatus == ZQV_DOWNLOADED;
}

}  // namespace

ZQVSelectView::ZQVSelectView(Eina_List* items, const char* senderName, const char* contentsToken)
    : _grid(items, ZQV_VIEW_SELECT),
      _items(items),
      _sender(senderName ? senderName : ""),
      _token(contentsToken ? contentsToken : "") {}

ZQVSelectView::~ZQVSelectView() {
  _clearChecks();
  if (_wifiPopup) _wifiPopup->forgetOwner();
}

const char* ZQVSelectView::getClassName() {
  return "ZQVSelectView";
}

Evas_Object* ZQVSelectView::onCreateView(Evas_Object* parent, void*) {
  if (!parent) {
    ZQV_ERROR("parent is NULL");
    return nullptr;
  }
  setTitle(kTitle);
  Evas_Object* layout =
      ZQViewerCommon::getInstance().createLayout(parent, "viewer_select_thumbnail_layout");
  _list = zqvCreateRowList(layout);
  elm_object_part_content_set(layout, "elm.swallow.recipient.text", _list);
  elm_object_part_content_set(layout, "elm.swallow.gengrid.layout",
                              _grid.createVertical(layout, "no_effect"));
  return layout;
}

void ZQVSelectView::onCreated() {
  // Checks that another page has left behind would be downloaded without having been seen.
  _clearChecks();
  zqvAppendRow(_list, new WGenlistItemMonoline1Check(kSelectAll), _listItemCb, this);
  _nameSelectAllRow();

  _selectableCount = 0;
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (!item || !isSelectable(*item)) continue;
    ++_selectableCount;
    _grid.append(item, _gridItemCb, this);
  }
}

void ZQVSelectView::onPushed(Elm_Object_Item* item) {
  elm_object_item_domain_text_translatable_set(item, ZQV_TEXT_DOMAIN, EINA_TRUE);
  _doneButton = _createTitleButton("naviframe/title_right", kDone, _doneBtnCb);
  elm_object_item_part_content_set(item, kDonePart, _doneButton);
  elm_object_disabled_set(_doneButton, EINA_TRUE);
  elm_object_item_part_content_set(
      item, kCancelPart, _createTitleButton("naviframe/title_left", kCancel, _cancelBtnCb));
  _rotation.connect(zqvWindowOf(*this), "rotation,changed", _rotateCb, this);
  zqvNamePage(*this, zqvText(kTitle));
}

bool ZQVSelectView::onPop() {
  _grid.forgetCells();
  return true;
}

void ZQVSelectView::setName(const char* name) {
  _sender = name ? name : "";
}

void ZQVSelectView::update(int event) {
  if (event != SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE) return;
  // The plain id is translated by the toolkit; the text with the count is translated already.
  _setTitleText(_selectedCount < 1 ? kTitle : zqvFormat(kCountTitle, "d", _selectedCount).c_str());
  for (Elm_Object_Item* row = elm_genlist_first_item_get(_list); row;
       row = elm_genlist_item_next_get(row)) {
    elm_genlist_item_update(row);
  }
  _nameSelectAllRow();
  _nameCells();

  const char* const parts[] = {kDonePart, kCancelPart};
  const char* const texts[] = {kDone, kCancel};
  for (int i = 0; i < 2; ++i) {
    Evas_Object* button = elm_object_item_part_content_get(getNaviItem(), parts[i]);
    if (!button) {
      ZQV_ERROR("toolbar part object is null!");
      return;
    }
    elm_object_domain_translatable_text_set(button, ZQV_TEXT_DOMAIN, texts[i]);
  }
  if (_wifiPopup) _wifiPopup->update(event);
}

void ZQVSelectView::_gridItemCb(void* data, Evas_Object*, void* cell) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  if (!cell) return;
  static_cast<ZQVSelectView*>(data)->_toggleItem(static_cast<Elm_Object_Item*>(cell));
}

void ZQVSelectView::_listItemCb(void* data, Evas_Object*, void* row) {
  if (!row) {
    ZQV_ERROR("Invalid argument: event info is NULL");
    return;
  }
  if (!data) {
    ZQV_ERROR("Invalid argument: data is NULL");
    return;
  }
  auto* rowItem = static_cast<Elm_Object_Item*>(row);
  elm_genlist_item_selected_set(rowItem, EINA_FALSE);
  auto* rowObject = zqvRowOf<WGenlistItemMonoline1Check>(elm_object_item_data_get(rowItem));
  if (!rowObject) {
    ZQV_ERROR("list_item is NULL");
    return;
  }
  static_cast<ZQVSelectView*>(data)->_toggleAll(rowObject);
}

void ZQVSelectView::_doneBtnCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  auto* view = static_cast<ZQVSelectView*>(data);
  if (!view->_grid.get()) {
    ZQV_ERROR("Get gengrid failed");
    return;
  }
  view->_downloadSelected();
}

void ZQVSelectView::_cancelBtnCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  auto* view = static_cast<ZQVSelectView*>(data);
  view->_clearChecks();
  view->getNaviframe()->pop();
}

void ZQVSelectView::_rotateCb(void* data, Evas_Object* window, void*) {
  if (!data || !window) {
    ZQV_ERROR("data || !obj");
    return;
  }
  auto* view = static_cast<ZQVSelectView*>(data);
  view->_grid.fitCells(window);
}

Evas_Object* ZQVSelectView::_createTitleButton(const char* style, const char* text,
                                               Evas_Smart_Cb clicked) {
  Evas_Object* button = elm_button_add(getNaviframe()->getEvasObj());
  elm_object_style_set(button, style);
  elm_object_domain_translatable_text_set(button, ZQV_TEXT_DOMAIN, text);
  evas_object_smart_callback_add(button, "clicked", clicked, this);
  return button;
}

void ZQVSelectView::_toggleItem(Elm_Object_Item* cell) {
  elm_gengrid_item_selected_set(cell, EINA_FALSE);
  ZQViewerThumbnailItem* item = itemOf(cell);
  if (!item) return;
  item->checked = !item->checked;
  // The check alone: making the whole cell anew would decode its picture again.
  elm_gengrid_item_fields_update(cell, kCheckPart, ELM_GENGRID_ITEM_FIELD_CONTENT);
  _nameCell(*item);
  _selectedCount += item->checked ? 1 : -1;

  WGenlistItemMonoline1Check* row = _selectAllRow();
  if (row) row->setChecked(_selectedCount == _selectableCount);
  _nameSelectAllRow();
  elm_object_disabled_set(_doneButton, _selectedCount == 0);
  _showSelectedCount();
}

void ZQVSelectView::_toggleAll(WGenlistItemMonoline1Check* row) {
  const bool wasChecked = row->isChecked();
  row->setChecked(!wasChecked);
  _nameSelectAllRow();
  if (!_grid.get()) {
    ZQV_ERROR("Fail to get gengrid");
    return;
  }
  for (Elm_Object_Item* cell = elm_gengrid_first_item_get(_grid.get()); cell;
       cell = elm_gengrid_item_next_get(cell)) {
    ZQViewerThumbnailItem* item = itemOf(cell);
    item->checked = !wasChecked;
    // A cell out of sight has no check yet; it takes the state when it comes into sight.
    if (elm_object_item_part_content_get(cell, kCheckPart)) item->setCheckStatus(!wasChecked);
    _nameCell(*item);
  }
  _selectedCount = wasChecked ? 0 : _selectableCount;
  // So with an empty grid Done becomes enabled, with nothing to do; that is intended.
  elm_object_disabled_set(_doneButton, wasChecked);
  _showSelectedCount();
}

void ZQVSelectView::_downloadSelected() {
  int count = 0;
  int64_t totalSize = 0;
  for (Elm_Object_Item* cell = elm_gengrid_first_item_get(_grid.get()); cell;
       cell = elm_gengrid_item_next_get(cell)) {
    const ZQViewerThumbnailItem* item = itemOf(cell);
    if (!item->checked) continue;
    ++count;
    totalSize += item->fileSize;
  }
  ZQVOrlantLog::getInstance().insertSelectDownloadCount(count);
  if (count == 0) return;
  if (totalSize > ZQV_LARGEST_UNASKED_DOWNLOAD) {
    _askBeforeDownload(static_cast<uint64_t>(totalSize));
  } else if (zqvNetworkAllowsDownload(false)) {
    _downloadFile(this);
  }
}

void ZQVSelectView::_askBeforeDownload(uint64_t totalSize) {
  if (_wifiPopup) return;
  auto* popup = new ZQVWifiSelectPopup(totalSize, &_wifiPopup);
  _wifiPopup = popup;
  popup->setDownloadCb([this, popup](bool*) { _downloadRequest(popup); });
  attachPopup(popup);
}

void ZQVSelectView::_downloadRequest(const ZQVWifiSelectPopup* popup) {
  _isWifiOnly = popup->isWifiOnly();
  if (zqvNetworkAllowsDownload(_isWifiOnly)) _downloadFile(this);
}

void ZQVSelectView::_downloadFile(ZQVSelectView* view) {
  if (!view) {
    ZQV_ERROR("data is NULL");
    return;
  }
  if (view->_isHandedOver) return;
  view->_isHandedOver = true;
  // The page goes first. It takes nothing along that the hand-over needs: that has its own copies.
  ZQVDownloadMgr download(view->_items, view->_isWifiOnly, ZQV_FROM_SELECT_VIEW,
                          view->_sender.c_str(), view->_token.c_str());
  view->getNaviframe()->pop();
  download._downloadMgrCreate();
}

WGenlistItemMonoline1Check* ZQVSelectView::_selectAllRow() const {
  Elm_Object_Item* first = _list ? elm_genlist_first_item_get(_list) : nullptr;
  return first ? zqvRowOf<WGenlistItemMonoline1Check>(elm_object_item_data_get(first)) : nullptr;
}

void ZQVSelectView::_nameSelectAllRow() {
  const WGenlistItemMonoline1Check* row = _selectAllRow();
  if (!row) return;
  std::string name = zqvText(kSelectAll);
  if (row->isChecked()) name.append(", ").append(zqvText("selected"));
  zqvSetAccessibleName(row->getElmObjectItem(), name);
}

void ZQVSelectView::_nameCell(const ZQViewerThumbnailItem& item) {
  std::string name = zqvCellName(item);
  if (item.checked) name.append(", ").append(zqvText("selected"));
  zqvSetAccessibleName(item.gridItems[ZQV_VIEW_SELECT], name);
}

void ZQVSelectView::_nameCells() {
  const Eina_List* node = nullptr;
  void* item = nullptr;
  EINA_LIST_FOREACH(_items, node, item) {
    if (item) _nameCell(*static_cast<ZQViewerThumbnailItem*>(item));
  }
}

void ZQVSelectView::_clearChecks() {
  const Eina_List* node = nullptr;
  void* item = nullptr;
  EINA_LIST_FOREACH(_items, node, item) {
    if (item) static_cast<ZQViewerThumbnailItem*>(item)->checked = false;
  }
}

void ZQVSelectView::_showSelectedCount() {
  if (_selectedCount < 1) {
    _setTitleText(zqvText(kTitle));
  } else {
    _setTitleText(zqvFormat(kCountTitle, "d", _selectedCount).c_str());
  }
}

void ZQVSelectView::_setTitleText(const char* text) {
  elm_object_item_domain_translatable_part_text_set(getNaviItem(), nullptr, ZQV_TEXT_DOMAIN, text);
  zqvNamePage(*this, zqvText(text));
}
