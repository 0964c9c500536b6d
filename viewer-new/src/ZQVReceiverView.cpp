#include "ZQVReceiverView.h"

#include <system_settings.h>
#include <unicode/ustring.h>
#include <vconf.h>

#include <utility>

#include "ZQVAccess.h"
#include "ZQVCommon.h"
#include "ZQVFullView.h"
#include "ZQVLog.h"
#include "ZQVMarkup.h"
#include "ZQVOwned.h"
#include "ZQVSelectView.h"
#include "ZQVSizeText.h"
#include "ZQVStatusMessage.h"
#include "ZQVText.h"
#include "ZQVThumbItem.h"
#include "ZQVWindow.h"

namespace {

constexpr size_t kTextLimit = 512;
constexpr const char* kRegionFormat = "db/menu_widget/regionformat";
constexpr const char* kTitle = "IDS_RSH_HEADER_FILES_SHARED_BY_PS_ABB";
constexpr const char* kDownloadText = "IDS_RSH_BUTTON_DOWNLOAD_ABB3";

const char* nonNull(const char* text) {
  return text ? text : "";
}

}  // namespace

ZQVReceiverView::ZQVReceiverView(Eina_List* items, bool isSingleShare, uint64_t totalSize,
                                 uint64_t expiry, const char* senderName, const char* contentsToken)
    : _items(items),
      _isSingleShare(isSingleShare),
      _totalSize(totalSize),
      _expiry(expiry),
      _grid(items, ZQV_VIEW_RECEIVER),
      _senderName(nonNull(senderName)),
      _contentsToken(nonNull(contentsToken)) {}

ZQVReceiverView::~ZQVReceiverView() {
  _signals.stop();
  _filler.stop();
  if (_grid.get()) {
    evas_object_event_callback_del_full(_grid.get(), EVAS_CALLBACK_DEL, _gridDeletedCb, this);
  }
  // Who was sent here for one share goes back to where they came from.
  if (_isSingleShare) ZQViewerCommon::getInstance().safeExit(_window);
}

const char* ZQVReceiverView::getClassName() {
  return "ZQVReceiverView";
}

Evas_Object* ZQVReceiverView::onCreateView(Evas_Object* parent, void*) {
  if (!parent) {
    ZQV_ERROR("parent is NULL");
    return nullptr;
  }
  _window = elm_object_top_widget_get(parent);
  setTitle(_titleText().c_str());
  Evas_Object* layout = ZQViewerCommon::getInstance().createLayout(
      parent, _isSingleShare ? "receiver_viewer_shared_file_thumbnail_layout_4line"
                             : "receiver_viewer_shared_file_thumbnail_layout_2line");

  _label = elm_label_add(layout);
  elm_object_style_set(_label, "popup/default");
  elm_label_line_wrap_set(_label, ELM_WRAP_MIXED);
  _showSummary();
  elm_object_part_content_set(layout, "elm.swallow.label.text", _label);

  Evas_Object* grid = _grid.createVertical(parent, nullptr);
  evas_object_event_callback_add(grid, EVAS_CALLBACK_DEL, _gridDeletedCb, this);
  elm_object_part_content_set(layout, "elm.swallow.gengrid.layout", grid);
  _launchDbusMonitor();
  return layout;
}

void ZQVReceiverView::onCreated() {
  _filler.fill(_grid, _items, _gridItemCb, this);
}

Elm_Object_Item* ZQVReceiverView::onPushToNaviframe(Evas_Object* naviframe) {
  Evas_Object* back = zqvAddBackButton(naviframe, _backButtonCb, this);
  return elm_naviframe_item_push(naviframe, getTitle(), back, nullptr, getEvasObj(), nullptr);
}

void ZQVReceiverView::onPushed(Elm_Object_Item* item) {
  elm_object_item_domain_text_translatable_set(item, ZQV_TEXT_DOMAIN, EINA_TRUE);
  _nameTitle();
  Evas_Object* download = elm_button_add(elm_object_item_widget_get(item));
  elm_object_style_set(download, "bottom");
  elm_object_domain_translatable_text_set(download, ZQV_TEXT_DOMAIN, kDownloadText);
  evas_object_smart_callback_add(download, "clicked", _downloadBtnCb, this);
  elm_object_item_part_content_set(item, "toolbar", download);
  _rotation.connect(_window, "rotation,changed", _rotateCb, this);
  _updateToolbarState();
}

bool ZQVReceiverView::onPop() {
  _filler.stop();
  _grid.forgetCells();
  return true;
}

/// A status may have changed while another page was on top.
void ZQVReceiverView::onBecomeTop() {
  _updateCells();
  _updateToolbarState();
}

void ZQVReceiverView::resetViewType(Evas_Object* grid) {
  ZQVItemGrid::resetViewType(grid);
}

void ZQVReceiverView::setName(const char* name) {
  _senderName = nonNull(name);
}

void ZQVReceiverView::update(int key) {
  if (key != SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE) return;
  const std::string title = _titleText();
  setTitle(title.c_str());
  elm_object_item_domain_translatable_text_set(getNaviItem(), ZQV_TEXT_DOMAIN, title.c_str());
  _nameTitle();
  _showSummary();
  _updateCells();
  Evas_Object* download = _toolbarButton();
  if (!download) {
    ZQV_ERROR("toolbar part object is null!");
    return;
  }
  elm_object_domain_translatable_text_set(download, ZQV_TEXT_DOMAIN, kDownloadText);
}

void ZQVReceiverView::_showSummary() {
  const ZQVOwnedText summary(getSummaryText());
  const bool isRightToLeft = elm_object_mirrored_get(_label);
  elm_object_text_set(_label, zqvFromReadingSide(summary.get(), isRightToLeft).c_str());
}

char* ZQVReceiverView::getSummaryText() const {
  const int count = static_cast<int>(eina_list_count(_items));
  std::string text = zqvFilesAndSize(count, _totalSize) + "<br>" + _expiryLine();
  if (_isSingleShare) text += "<br><br>" + _hint();
  return ZQViewerCommon::getInstance().makeThemeMarkup(text.c_str(), "T024", "left");
}

std::string ZQVReceiverView::_titleText() const {
  return zqvFormatName(kTitle, _senderName.c_str(), kTextLimit - 1);
}

/// A screen reader reads text, not markup.
void ZQVReceiverView::_nameTitle() {
  zqvSetAccessibleName(getNaviItem(), zqvFormat(kTitle, "s", _senderName.c_str()));
}

std::string ZQVReceiverView::_expiryLine() const {
  const ZQVPlatformText region(vconf_get_str(kRegionFormat));
  // The first three letters only: the day is shown without the time.
  UChar skeleton[16] = {};
  u_uastrncpy(skeleton, "yMdHm", 3);
  const ZQVOwnedText date(ZQViewerCommon::getInstance().getDateString(
      region.get(), skeleton, static_cast<double>(_expiry)));
  return zqvFormat("IDS_RSH_BODY_EXPIRED_ON_PS", "s", nonNull(date.get()));
}

std::string ZQVReceiverView::_hint() const {
  return zqvText(eina_list_count(_items) < 2
                     ? "IDS_RSH_BODY_TO_DOWNLOAD_THIS_FILE_LATER_GO_TO_MY_FILES_SHARING_HISTORY_"
                       "THEN_SELECT_THIS_MESSAGE"
                     : "IDS_RSH_BODY_TO_DOWNLOAD_THESE_FILES_LATER_GO_TO_MY_FILES_SHARING_HISTORY_"
                       "THEN_SELECT_THIS_MESSAGE");
}

void ZQVReceiverView::_launchDbusMonitor() {
  _signals.start([this](const char* member, const char* url) { _downloadSignalCb(member, url); });
}

void ZQVReceiverView::_downloadSignalCb(const char* member, const char* url) {
  const int32_t status = ZQVDownloadSignals::statusOf(member);
  ZQViewerThumbnailItem* item = _addresses.find(_items, url);
  Elm_Object_Item* cell = item ? item->gridItems[ZQV_VIEW_RECEIVER] : nullptr;
  if (cell && item->downloadStatus != status) {
    item->downloadStatus = status;
    zqvSetAccessibleName(cell, zqvCellName(*item));
    _redrawLater(item);
  }
  _updateToolbarState();
}

/// What a cell shows is built anew, which takes its time: once for all signals that came together,
/// or whoever sends many could keep the page from everything else.
void ZQVReceiverView::_redrawLater(ZQViewerThumbnailItem* item) {
  _changed.insert(item);
  if (!_redraw) _redraw = ZQVOwned<Ecore_Job, ecore_job_del>(ecore_job_add(_redrawCb, this));
}

void ZQVReceiverView::_redrawCb(void* data) {
  auto* view = static_cast<ZQVReceiverView*>(data);
  (void)view->_redraw.release();  // a job that runs frees itself
  for (const ZQViewerThumbnailItem* item : std::exchange(view->_changed, {})) {
    Elm_Object_Item* cell = item->gridItems[ZQV_VIEW_RECEIVER];
    // All fields of the cell, but not the cell: the toolkit finds a new one's place in the order of
    // focus among all others, which takes milliseconds where there are thousands.
    if (cell) elm_gengrid_item_fields_update(cell, nullptr, ELM_GENGRID_ITEM_FIELD_ALL);
  }
}

void ZQVReceiverView::_gridItemCb(void* data, Evas_Object*, void* cell) {
  if (!cell) {
    ZQV_ERROR("event_info is NULL");
    return;
  }
  auto* item = static_cast<Elm_Object_Item*>(cell);
  elm_gengrid_item_selected_set(item, EINA_FALSE);
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  static_cast<ZQVReceiverView*>(data)->_openFullView(item);
}

void ZQVReceiverView::_openFullView(Elm_Object_Item* cell) {
  auto* view =
      new ZQVFullView(_items, ZQV_VIEW_FULL_RECEIVER, _senderName.c_str(), _contentsToken.c_str());
  getNaviframe()->push(view, elm_object_item_data_get(cell), "fullview");
}

void ZQVReceiverView::_downloadBtnCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  static_cast<ZQVReceiverView*>(data)->_openSelectView();
}

void ZQVReceiverView::_openSelectView() {
  if (ZQViewerCommon::getInstance().zquiCommonCheckNetwork() == 0) {
    ZQV_ERROR("No network");
    zqvPostStatusMessage(
        "IDS_MF_POP_MOBILE_DATA_IS_TURNED_OFF_CONNECT_TO_A_WI_FI_NETWORK_INSTEAD_MSG");
    return;
  }
  getNaviframe()->push(new ZQVSelectView(_items, _senderName.c_str(), _contentsToken.c_str()));
}

void ZQVReceiverView::_backButtonCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  static_cast<ZQVReceiverView*>(data)->getNaviframe()->pop();
}

void ZQVReceiverView::_rotateCb(void* data, Evas_Object* window, void*) {
  if (!data || !window) {
    ZQV_ERROR("data || !obj");
    return;
  }
  auto* view = static_cast<ZQVReceiverView*>(data);
  view->_grid.fitCells(window);
}

void ZQVReceiverView::_gridDeletedCb(void* data, Evas*, Evas_Object* grid, void*) {
  static_cast<ZQVReceiverView*>(data)->resetViewType(grid);
}

/// What has been downloaded can be downloaded again; only what is on its way cannot.
void ZQVReceiverView::_updateToolbarState() {
  if (Evas_Object* download = _toolbarButton()) elm_object_disabled_set(download, !_isAnyToHave());
}

bool ZQVReceiverView::_isAnyToHave() const {
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    const auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (item &&
        (item->downloadStatus == ZQV_NOT_DOWNLOADED || item->downloadStatus == ZQV_DOWNLOADED)) {
      return true;
    }
  }
  return false;
}

void ZQVReceiverView::_updateCells() {
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    const auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    Elm_Object_Item* cell = item ? item->gridItems[ZQV_VIEW_RECEIVER] : nullptr;
    if (!cell) continue;
    elm_gengrid_item_fields_update(cell, "elm.swallow.end", ELM_GENGRID_ITEM_FIELD_CONTENT);
    elm_gengrid_item_fields_update(cell, "elm.swallow.icon", ELM_GENGRID_ITEM_FIELD_CONTENT);
    zqvSetAccessibleName(cell, zqvCellName(*item));
  }
}

Evas_Object* ZQVReceiverView::_toolbarButton() const {
  Elm_Object_Item* item = getNaviItem();
  return item ? elm_object_item_part_content_get(item, "toolbar") : nullptr;
}
