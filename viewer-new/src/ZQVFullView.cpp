#include "ZQVFullView.h"

#include <Ecore_File.h>
#include <app_control.h>
#include <system_settings.h>

#include "ZQVAccess.h"
#include "ZQVCommon.h"
#include "ZQVDownloadMgr.h"
#include "ZQVDownloadRule.h"
#include "ZQVDownloadedFile.h"
#include "ZQVFrames.h"
#include "ZQVFullCell.h"
#include "ZQVLog.h"
#include "ZQVOrlantLog.h"
#include "ZQVOwned.h"
#include "ZQVPager.h"
#include "ZQVPictureButton.h"
#include "ZQVStatusMessage.h"
#include "ZQVText.h"
#include "ZQVUnableOpenFilePopup.h"
#include "ZQVWifiSelectPopup.h"
#include "ZQVWindow.h"

namespace {

constexpr const char* kOpen = "IDS_RSH_BUTTON_OPEN";
constexpr const char* kDownload = "IDS_RSH_BUTTON_DOWNLOAD_ABB3";
constexpr const char* kServiceFolder = "/opt/usr/apps/com.orlant.zelqo/shared/data/";
/// Long enough for the layout to settle after the pager got a new size.
constexpr double kSettleTime = 0.1;
/// The toolkit's way to say "as many as you like".
constexpr int kNoPageLimit = 9999;
constexpr const char* kArrows[] = {"Left", "Right"};

void setButton(Evas_Object* button, const char* text, bool isEnabled) {
  elm_object_domain_translatable_text_set(button, ZQV_TEXT_DOMAIN, text);
  elm_object_disabled_set(button, !isEnabled);
}

bool isSameAddress(const char* a, const char* b) {
  return a && b && g_strcmp0(a, b) == 0;
}

void openReplyCb(app_control_h, app_control_h, app_control_result_e, void*) {}

/// Gives a file to whichever application shows its kind; false when none takes it.
bool launchViewer(app_control_h request, const char* path) {
  app_control_set_uri(request, path);
  app_control_set_operation(request, APP_CONTROL_OPERATION_VIEW);
  app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP);
  return zqvMayBeOpened(path) &&
         app_control_send_launch_request(request, openReplyCb, nullptr) == APP_CONTROL_ERROR_NONE;
}

}  // namespace

ZQVFullView::ZQVFullView(Eina_List* items, int32_t viewKind, const char* sender, const char* token)
    : _items(items),
      _sender(sender ? sender : ""),
      _token(token ? token : ""),
      _grid(items, static_cast<ZQVViewType>(viewKind)) {}

ZQVFullView::~ZQVFullView() {
  _signals.stop();
  _leaveKeys();
  _clearMark();
  if (_unablePopup) _unablePopup->forgetOwner();
  if (_wifiPopup) _wifiPopup->forgetOwner();
  if (!_grid.get()) return;
  evas_object_smart_callback_del_full(_grid.get(), "realized", _realizedCb, this);
  evas_object_smart_callback_del_full(_grid.get(), "scroll", _scrollCb, this);
  evas_object_event_callback_del_full(_grid.get(), EVAS_CALLBACK_RESIZE, _resizedCb, this);
  evas_object_data_del(_grid.get(), ZQVFullCell::kOpening);
  evas_object_data_del(_grid.get(), ZQVPictureButton::kBoundData);
  evas_object_data_del(_grid.get(), ZQVPictureButton::kBoundButton);
}

const char* ZQVFullView::getClassName() {
  return "ZQVFullView";
}

Evas_Object* ZQVFullView::onCreateView(Evas_Object* parent, void* viewParam) {
  if (!parent) {
    ZQV_ERROR("parent is NULL");
    return nullptr;
  }
  if (!viewParam) {
    ZQV_ERROR("viewParam is NULL");
    return nullptr;
  }
  _passedItem = static_cast<ZQViewerThumbnailItem*>(viewParam);
  if (zqvIsDownloaded(*_passedItem)) _passedItem->downloadStatus = ZQV_DOWNLOADED;
  _grid.create(parent);
  _setUpPager();
  _signals.start([this](const char* member, const char* url) { _downloadSignalCb(member, url); });
  return _grid.get();
}

void ZQVFullView::onCreated() {
  int32_t position = 0;
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (!item || !_grid.append(item, nullptr, nullptr)) continue;
    // Files may have been dropped from the share; here page and file always agree.
    item->index = position++;
  }
  evas_object_data_set(_grid.get(), ZQVFullCell::kOpening, _passedItem);
  _curItem = _passedItem;
  _currentPage = _passedItem->index;
}

Elm_Object_Item* ZQVFullView::onPushToNaviframe(Evas_Object* naviframe) {
  Evas_Object* back = zqvAddBackButton(naviframe, _backButtonCb, this);
  return elm_naviframe_item_push(naviframe, getTitle(), back, nullptr, getEvasObj(),
                                 *getItemStyle() ? getItemStyle() : nullptr);
}

void ZQVFullView::onPushed(Elm_Object_Item* item) {
  if (!item) {
    ZQV_ERROR("naviItem is NULL");
    return;
  }
  _toolButton = elm_button_add(getNaviframe()->getEvasObj());
  elm_object_style_set(_toolButton, "bottom");
  evas_object_smart_callback_add(_toolButton, "clicked", fullViewerToolBtnCb, this);
  elm_object_item_part_content_set(item, "toolbar", _toolButton);
  evas_object_data_set(_grid.get(), ZQVPictureButton::kBoundData, this);
  evas_object_data_set(_grid.get(), ZQVPictureButton::kBoundButton, _toolButton.get());
  _rotation.connect(zqvWindowOf(*this), "rotation,changed", _rotateCb, this);
  _takeKeys(zqvWindowOf(*this));
  if (_isSentShare()) {
    elm_object_domain_translatable_text_set(_toolButton, ZQV_TEXT_DOMAIN, kOpen);
  } else {
    _createTitleIcon(item);
  }
  _updateDownloadedStatus();
}

bool ZQVFullView::onPop() {
  _grid.forgetCells();
  return true;
}

void ZQVFullView::setName(const char* name) {
  _sender = name ? name : "";
}

void ZQVFullView::update(int event) {
  if (event != SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE) return;
  Evas_Object* button = elm_object_item_part_content_get(getNaviItem(), "toolbar");
  if (!button) {
    ZQV_ERROR("toolbar part object is null!");
    return;
  }
  if (!_passedItem) {
    ZQV_ERROR("_passedItem is null!");
    return;
  }
  // It is the file that the page was opened with that counts here, not the one on screen. A sent
  // file is only ever opened.
  const bool isOpen = _isSentShare() || _passedItem->downloadStatus == ZQV_DOWNLOADED;
  elm_object_domain_translatable_text_set(button, ZQV_TEXT_DOMAIN, isOpen ? kOpen : kDownload);
  if (_unablePopup) _unablePopup->update(event);
  if (_wifiPopup) _wifiPopup->update(event);
  _grid.nameCells();
  if (_curItem) zqvNamePage(*this, zqvCellName(*_curItem));
  _fitPages();  // they may run the other way now
}

void ZQVFullView::_realizedCb(void* data, Evas_Object* pager, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  int width = 0;
  int cellWidth = 0;
  evas_object_geometry_get(pager, nullptr, nullptr, &width, nullptr);
  elm_gengrid_item_size_get(pager, &cellWidth, nullptr);
  if (width != cellWidth) static_cast<ZQVFullView*>(data)->_fitPages();
}

void ZQVFullView::_scrollCb(void* data, Evas_Object* pager, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  auto* view = static_cast<ZQVFullView*>(data);
  // While the pages are being fitted the pager drifts; the page on screen stays the current one.
  if (view->_delayer.isRunning()) return;
  // Nor is it another page that pages now run the other way; update() fits them anew.
  if (view->_isMirrored != elm_config_mirrored_get()) return;
  const int page = zqvPageOnScreen(pager);
  if (page == view->_currentPage) return;
  view->_currentPage = page;
  view->_curItem = view->_itemOfPage(page);
  view->_updateDownloadedStatus();
  view->_neighbours.lookAround(view->_currentCell());
}

void ZQVFullView::_rotateCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  static_cast<ZQVFullView*>(data)->_fitPages();
}

void ZQVFullView::_backButtonCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  static_cast<ZQVFullView*>(data)->getNaviframe()->pop();
}

void ZQVFullView::fullViewerToolBtnCb(void* data, Evas_Object* button, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  auto* view = static_cast<ZQVFullView*>(data);
  if (!view->_curItem) {
    ZQV_ERROR("_curItem is NULL");
    return;
  }
  const char* text = elm_object_text_get(button);
  if (view->_curItem->noThumbnail || !text || !*text) return;
  if (g_strcmp0(text, zqvText(kOpen)) == 0) {
    view->_openCurrent();
  } else {
    view->_downloadCurrent();
  }
}

bool ZQVFullView::_delayerSetSize(void* data) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return false;
  }
  auto* view = static_cast<ZQVFullView*>(data);
  Evas_Object* pager = view->_grid.get();
  if (!pager) return false;
  zqvShowPage(pager, view->_currentPage);
  Eina_Bool isVerticalSnap = EINA_FALSE;
  elm_scroller_page_snap_get(pager, nullptr, &isVerticalSnap);
  elm_scroller_page_snap_set(pager, EINA_TRUE, isVerticalSnap);
  view->_neighbours.lookAround(view->_currentCell());
  return false;
}

void ZQVFullView::_downloadRequest(ZQVFullView* view, ZQVWifiSelectPopup* popup) {
  if (!view) {
    ZQV_ERROR("data is NULL");
    return;
  }
  view->_isWifiOnly = popup->isWifiOnly();
  if (!zqvNetworkAllowsDownload(view->_isWifiOnly)) return;
  view->_handOver();
  popup->close();
}

void ZQVFullView::_setUpPager() {
  Evas_Object* pager = _grid.get();
  evas_object_size_hint_weight_set(pager, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  elm_gengrid_horizontal_set(pager, EINA_TRUE);
  elm_gengrid_multi_select_set(pager, EINA_TRUE);
  elm_scroller_policy_set(pager, ELM_SCROLLER_POLICY_OFF, ELM_SCROLLER_POLICY_OFF);
  elm_gengrid_select_mode_set(pager, ELM_OBJECT_SELECT_MODE_NONE);
  evas_object_smart_callback_add(pager, "realized", _realizedCb, this);
  elm_scroller_page_relative_set(pager, 1.0, 0.0);
  elm_interface_scrollable_page_scroll_limit_set(pager, 1, kNoPageLimit);
  elm_object_scroll_lock_y_set(pager, EINA_TRUE);
  elm_scroller_single_direction_set(pager, ELM_SCROLLER_SINGLE_DIRECTION_HARD);
  evas_object_smart_callback_add(pager, "scroll", _scrollCb, this);
  evas_object_event_callback_add(pager, EVAS_CALLBACK_RESIZE, _resizedCb, this);
  zqvColorPage(pager);
  evas_object_show(pager);
}

void ZQVFullView::_resizedCb(void* data, Evas*, Evas_Object*, void*) {
  static_cast<ZQVFullView*>(data)->_fitPages();
}

/// The pager takes the arrows to move among pages to select, of which it has none; the window has
/// them, too.
void ZQVFullView::_takeKeys(Evas_Object* window) {
  if (!window) return;
  _window = window;
  for (const char* key : kArrows) {
    if (!evas_object_key_grab(window, key, 0, 0, EINA_FALSE)) ZQV_ERROR("no key %s", key);
  }
  evas_object_event_callback_add(window, EVAS_CALLBACK_KEY_DOWN, _keyCb, this);
}

void ZQVFullView::_leaveKeys() {
  if (!_window) return;
  evas_object_event_callback_del_full(_window, EVAS_CALLBACK_KEY_DOWN, _keyCb, this);
  for (const char* key : kArrows) evas_object_key_ungrab(_window, key, 0, 0);
}

void ZQVFullView::_keyCb(void* data, Evas*, Evas_Object* window, void* info) {
  auto* view = static_cast<ZQVFullView*>(data);
  const char* key = static_cast<Evas_Event_Key_Down*>(info)->key;
  const bool isLeft = g_strcmp0(key, kArrows[0]) == 0;
  if (!isLeft && g_strcmp0(key, kArrows[1]) != 0) return;
  Evas_Object* pager = view->_grid.get();
  if (elm_object_focused_object_get(window) != pager) return;
  const bool isBack = isLeft != (elm_object_mirrored_get(pager) != EINA_FALSE);
  const int page = view->_currentPage + (isBack ? -1 : 1);
  if (view->_itemOfPage(page)) zqvShowPage(pager, page);
}

/// Makes every page as large as the pager, keeps the page on screen, and lets paging snap again
/// once the layout has settled.
void ZQVFullView::_fitPages() {
  if (!zqvFitPages(_grid.get())) return;
  _isMirrored = elm_object_mirrored_get(_grid.get());
  // With snapping on, the pager would move by one page only.
  elm_scroller_page_snap_set(_grid.get(), EINA_FALSE, EINA_FALSE);
  zqvShowPage(_grid.get(), _currentPage);
  _delayer.start(kSettleTime, [this] { return _delayerSetSize(this); });
}

Elm_Object_Item* ZQVFullView::_currentCell() const {
  return _curItem ? _curItem->gridItems[_grid.getViewType()] : nullptr;
}

void ZQVFullView::_createTitleIcon(Elm_Object_Item* item) {
  _titleLayout = ZQViewerCommon::getInstance().createLayout(getNaviframe()->getEvasObj(),
                                                            "layout/naviframe/title_right");
  elm_object_item_part_content_set(item, "title_right_btn", _titleLayout);
  if (_passedItem->downloadStatus == ZQV_DOWNLOADING) {
    ZQV_TRACE("downloading icon:%s", zqvDownloadingLargeFrames[0]);
  } else if (_passedItem->downloadStatus == ZQV_DOWNLOADED) {
    ZQV_TRACE("downloaded icon:%s", zqvDownloadedLargeFrames[0]);
  }
}

/// Null shows no icon. The same frames again do not restart a running animation.
void ZQVFullView::_showTitleIcon(const char** frames) {
  if (frames == _titleFrames || !_titleLayout) return;
  _titleFrames = frames;
  Evas_Object* icon =
      frames ? ZQViewerCommon::getInstance().createGif(_titleLayout, frames) : nullptr;
  elm_object_part_content_set(_titleLayout, "content", icon);
}

void ZQVFullView::_updateDownloadedStatus() {
  if (!_curItem) {
    ZQV_ERROR("_curItem is NULL");
    return;
  }
  // The page has no title; to screen readers it is the file on it.
  zqvNamePage(*this, zqvCellName(*_curItem));
  if (_isSentShare()) {
    _updateSentStatus();
    return;
  }
  switch (_curItem->downloadStatus) {
    case ZQV_DOWNLOADING:
      setButton(_toolButton, kDownload, false);
      _showTitleIcon(zqvDownloadingLargeFrames);
      break;
    case ZQV_DOWNLOADED:
      setButton(_toolButton, kOpen, true);
      _showTitleIcon(zqvDownloadedLargeFrames);
      break;
    default:
      setButton(_toolButton, kDownload, true);
      _showTitleIcon(nullptr);
  }
}

void ZQVFullView::_updateSentStatus() {
  if (!_curItem->filePath) {
    ZQV_ERROR("_curItem->filePath is NULL");
    return;
  }
  elm_object_disabled_set(_toolButton, _isInServiceFolder(*_curItem) || _curItem->noThumbnail);
}

bool ZQVFullView::_isInServiceFolder(const ZQViewerThumbnailItem& item) const {
  if (!item.filePath || !item.fileName) return false;
  return std::string(kServiceFolder) + item.fileName == item.filePath;
}

void ZQVFullView::_downloadSignalCb(const char* member, const char* url) {
  ZQViewerThumbnailItem* item = _grid.get() ? _addresses.find(_items, url) : nullptr;
  Elm_Object_Item* cell = item ? item->gridItems[_grid.getViewType()] : nullptr;
  if (!cell) return;
  // The page below follows the signals, too: the status may be the new one already.
  item->downloadStatus = ZQVDownloadSignals::statusOf(member);
  zqvSetAccessibleName(cell, zqvCellName(*item));
  if (item == _curItem) _updateDownloadedStatus();
}

/// A hand-over takes every checked file; this page never leaves more than one check behind.
void ZQVFullView::_markForDownload(ZQViewerThumbnailItem* item) {
  _clearMark();
  item->checked = true;
  _markedItem = item;
}

void ZQVFullView::_clearMark() {
  if (_markedItem) _markedItem->checked = false;
  _markedItem = nullptr;
}

void ZQVFullView::_downloadCurrent() {
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_FOREACH(_items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (!item || !isSameAddress(item->downloadUrl, _curItem->downloadUrl)) continue;
    _markForDownload(item);
    break;
  }
  _downloadFile(this, _curItem);
}

void ZQVFullView::_openCurrent() {
  std::string path;
  if (_isSentShare()) {
    if (_isInServiceFolder(*_curItem)) return;
    if (!_curItem->filePath) {
      ZQV_ERROR("_curItem->filePath is NULL");
      return;
    }
    path = _curItem->filePath;
  } else {
    path = zqvDownloadedPath(*_curItem);
  }
  if (ecore_file_exists(path.c_str())) {
    _openFile(path.c_str());
  } else {
    _offerDownloadAgain();
  }
}

void ZQVFullView::_downloadFile(ZQVFullView* view, ZQViewerThumbnailItem* item) {
  if (!item) {
    ZQV_ERROR("item is NULL");
    return;
  }
  if (!view) {
    ZQV_ERROR("data is NULL");
    return;
  }
  if (item->fileSize > ZQV_LARGEST_UNASKED_DOWNLOAD) {
    view->_askBeforeDownload(item->fileSize);
  } else if (zqvNetworkAllowsDownload(false)) {
    view->_handOver();
  } else {
    view->_clearMark();
  }
}

void ZQVFullView::_handOver() {
  ZQVDownloadMgr download(_items, _isWifiOnly, ZQV_FROM_FULL_VIEW, _sender.c_str(), _token.c_str());
  download._downloadMgrCreate();
  // A later download must not carry this file again.
  _clearMark();
}

void ZQVFullView::_askBeforeDownload(uint32_t size) {
  if (_wifiPopup) return;
  auto* popup = new ZQVWifiSelectPopup(size, &_wifiPopup);
  _wifiPopup = popup;
  popup->setDownloadCb([this, popup](bool*) { _downloadRequest(this, popup); });
  attachPopup(popup);
}

void ZQVFullView::_offerDownloadAgain() {
  if (_unablePopup) return;
  auto* popup = new ZQVUnableOpenFilePopup(&_unablePopup);
  _unablePopup = popup;
  popup->setDownloadCb([this](bool*) {
    if (_curItem) _markForDownload(_curItem);
    _downloadFile(this, _curItem);
  });
  attachPopup(popup);
}

void ZQVFullView::_openFile(const char* path) {
  if (!path) {
    ZQV_ERROR("fileUrl is NULL");
    return;
  }
  ZQVOwnedAppControl request;
  if (app_control_create(request.out()) != APP_CONTROL_ERROR_NONE) return;
  if (!launchViewer(request.get(), path)) {
    zqvPostStatusMessage("IDS_RSH_TPOP_UNABLE_TO_FIND_APPLICATION_TO_PERFORM_THIS_ACTION");
  }
  ZQVOrlantLog::getInstance().insertFullOpenContentstype(path);
}

/// The last file with this number, null when there is none.
ZQViewerThumbnailItem* ZQVFullView::_itemOfPage(int page) const {
  const Eina_List* node = nullptr;
  void* data = nullptr;
  EINA_LIST_REVERSE_FOREACH(_items, node, data) {
    auto* item = static_cast<ZQViewerThumbnailItem*>(data);
    if (item && item->index == page) return item;
  }
  return nullptr;
}
