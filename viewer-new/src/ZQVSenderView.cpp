#include "ZQVSenderView.h"

#include <gio/gio.h>
#include <system_settings.h>
#include <zelqo.h>

#include "WGenlistItemGroup.h"
#include "WGenlistItemMonoline1Icon.h"
#include "ZQVAccess.h"
#include "ZQVCommon.h"
#include "ZQVFullView.h"
#include "ZQVLog.h"
#include "ZQVMarkup.h"
#include "ZQVOrlantLog.h"
#include "ZQVOwned.h"
#include "ZQVRows.h"
#include "ZQVStatusMessage.h"
#include "ZQVText.h"
#include "ZQVWindow.h"

namespace {

constexpr const char* kTitle = "IDS_RSH_HEADER_SHARED_FILES_ABB";
constexpr const char* kRecall = "IDS_RSH_BUTTON_RECALL_ABB";
constexpr const char* kReshare = "IDS_RSH_BUTTON_RESHARE_ABB";
constexpr const char* kRecalling = "IDS_RSH_POP_RECALLING_FILES_ING";

constexpr int kButtonWidth = 300;
constexpr int kButtonHeight = 104;
constexpr int kButtonGap = 32;
constexpr double kRecallTimeout = 60.0;
constexpr size_t kLongestRowText = 1024;

constexpr const char* kHistoryPath = "/com/orlant/remoteshare";
constexpr const char* kHistoryInterface = "org.tizen.call.remote.share";

/// Cut to whole pixels; the toolkit's own scaling would round.
int scaled(int value) {
  return static_cast<int>(value * elm_config_scale_get() / elm_app_base_scale_get());
}

void setToolbarButtonSize(Evas_Object* button) {
  evas_object_size_hint_min_set(button, scaled(kButtonWidth), scaled(kButtonHeight));
}

void exitCb(void*, Evas_Object*, void*) {
  elm_exit();
}

void logAndClear(GError** error) {
  if (!*error) return;
  ZQV_ERROR("error : %s", (*error)->message);
  g_clear_error(error);
}

}  // namespace

ZQVSenderView::ZQVSenderView(Eina_List* items, bool firstFlag, bool isGridOnly,
                             uint32_t uploadHandle, const char* recipientName,
                             int32_t recipientCount, const char* recipientImage)
    : _items(items),
      _grid(items, ZQV_VIEW_SENDER),
      _firstFlag(firstFlag),
      _isGridOnly(isGridOnly),
      _uploadHandle(uploadHandle),
      _recipientCount(recipientCount) {
  setRecipients(recipientName, recipientImage);
}

ZQVSenderView::~ZQVSenderView() {
  if (_processingPopup) evas_object_del(_processingPopup);
}

const char* ZQVSenderView::getClassName() {
  return "ZQVSenderView";
}

Evas_Object* ZQVSenderView::onCreateView(Evas_Object* parent, void*) {
  if (!parent) {
    ZQV_ERROR("parent is NULL");
    return nullptr;
  }
  setTitle(kTitle);
  if (_isGridOnly) {
    Evas_Object* grid = _grid.createVertical(parent, nullptr);
    zqvColorPage(grid);
    return grid;
  }
  Evas_Object* layout = ZQViewerCommon::getInstance().createLayout(
      parent, "sender_viewer_shared_file_thumbnail_layout");
  _list = zqvCreateRowList(layout);
  elm_object_part_content_set(layout, "elm.swallow.recipient.text", _list);
  elm_object_part_content_set(layout, "elm.swallow.gengrid.layout",
                              _grid.createVertical(layout, nullptr));
  return layout;
}

void ZQVSenderView::onCreated() {
  if (!_grid.get()) {
    ZQV_ERROR("parent is NULL");
    return;
  }
  if (!_isGridOnly) {
    if (!_list) {
      ZQV_ERROR("parent is NULL");
      return;
    }
    _fillList();
  }
  if (!_items) {
    ZQV_ERROR("_thumbList is NULL");
    return;
  }
  _filler.fill(_grid, _items, _gridItemCb, this);
}

Elm_Object_Item* ZQVSenderView::onPushToNaviframe(Evas_Object* naviframe) {
  Evas_Object* back = zqvAddBackButton(naviframe, exitCb, nullptr);
  return elm_naviframe_item_push(naviframe, getTitle(), back, nullptr, getEvasObj(), nullptr);
}

void ZQVSenderView::onPushed(Elm_Object_Item* item) {
  elm_object_item_domain_text_translatable_set(item, ZQV_TEXT_DOMAIN, EINA_TRUE);
  zqvNamePage(*this, zqvText(kTitle));
  if (!_isGridOnly) {
    Evas_Object* box = elm_box_add(getNaviframe()->getEvasObj());
    elm_box_horizontal_set(box, EINA_TRUE);
    evas_object_size_hint_weight_set(box, 0.0, EVAS_HINT_EXPAND);
    evas_object_size_hint_align_set(box, 0.0, EVAS_HINT_FILL);
    elm_box_padding_set(box, scaled(kButtonGap), 0);
    evas_object_show(box);
    _recallButton = _createToolbarButton(box, kRecall, _recallBtnCb);
    if (!_recallButton) return;
    _reshareButton = _createToolbarButton(box, kReshare, _reshareBtnCb);
    if (!_reshareButton) return;
    elm_object_item_part_content_set(item, "toolbar", box);
  }
  _rotation.connect(zqvWindowOf(*this), "rotation,changed", _rotateCb, this);
}

bool ZQVSenderView::onPop() {
  _filler.stop();
  _grid.forgetCells();
  return true;
}

void ZQVSenderView::setLaunchRequest(app_control_h request) {
  _signUp.setLaunchRequest(request);
}

void ZQVSenderView::setRecipients(const char* text, const char* imagePath) {
  _recipientName = text ? text : "";
  _recipientImage = imagePath ? imagePath : "";
}

void ZQVSenderView::update(int event) {
  if (event != SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE) return;
  elm_object_item_domain_translatable_part_text_set(getNaviItem(), nullptr, ZQV_TEXT_DOMAIN,
                                                    kTitle);
  zqvNamePage(*this, zqvText(kTitle));
  _grid.nameCells();
  if (!_updateRows()) return;
  _updateToolbar();
  if (_processingPopup) {
    elm_object_domain_translatable_part_text_set(elm_object_content_get(_processingPopup),
                                                 "elm.text", ZQV_TEXT_DOMAIN, kRecalling);
  }
}

void ZQVSenderView::_gridItemCb(void* data, Evas_Object*, void* cell) {
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
  auto* view = static_cast<ZQVSenderView*>(data);
  view->getNaviframe()->push(new ZQVFullView(view->_items, ZQV_VIEW_FULL_SENDER, nullptr, nullptr),
                             elm_object_item_data_get(item), "fullview");
}

void ZQVSenderView::_rotateCb(void* data, Evas_Object* window, void*) {
  if (!data || !window) {
    ZQV_ERROR("data || !obj");
    return;
  }
  auto* view = static_cast<ZQVSenderView*>(data);
  view->_grid.fitCells(window);
}

void ZQVSenderView::_recallBtnCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  auto* view = static_cast<ZQVSenderView*>(data);
  if (!_checkZelqoStatus(view)) return;
  ZQVOrlantLog::getInstance().insertRecall();
  view->_confirmRecall();
}

void ZQVSenderView::_reshareBtnCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  auto* view = static_cast<ZQVSenderView*>(data);
  if (!_checkZelqoStatus(view)) return;
  ZQVOrlantLog::getInstance().insertReshare();
  ZQVOwnedText share(g_strdup_printf("%u", view->_uploadHandle));
  ZQViewerCommon::getInstance().reshare(share.get(), view->_firstFlag);
}

void ZQVSenderView::_recallUploadCb(int error, void* data) {
  auto* view = static_cast<ZQVSenderView*>(ZQVTicket::holderOf(data));
  if (!view) {
    ZQV_ERROR("user_data is NULL");
    return;
  }
  if (error) {
    ZQV_ERROR("Error happened(error_code = %d)", error);
    return;
  }
  // One recall, one signal: a second answer finds nobody.
  view->_recallTicket.withdraw();
  _sendDbusSignalToHistory(view, "recall", "default");
  elm_exit();
}

int ZQVSenderView::_sendDbusSignalToHistory(ZQVSenderView*, const char* member, const char* value) {
  GError* error = nullptr;
  ZQVOwned<GDBusConnection, g_object_unref> bus(g_bus_get_sync(G_BUS_TYPE_SYSTEM, nullptr, &error));
  if (!bus) ZQV_ERROR("g_bus_get_sync() is failed.");
  logAndClear(&error);
  if (!bus) return -1;
  ZQVOwned<GDBusMessage, g_object_unref> signal(
      g_dbus_message_new_signal(kHistoryPath, kHistoryInterface, member));
  if (!signal) {
    ZQV_ERROR("g_dbus_message_new_method_call() is failed.");
    return -1;
  }
  g_dbus_message_set_body(signal.get(), g_variant_new("(s)", value));
  if (!g_dbus_connection_send_message(bus.get(), signal.get(), G_DBUS_SEND_MESSAGE_FLAGS_NONE,
                                      nullptr, &error)) {
    ZQV_ERROR("g_dbus_connection_send_message_with_reply_sync() is failed.");
    logAndClear(&error);
  }
  // The process ends right after this: the signal has to be on its way by then.
  g_dbus_connection_flush_sync(bus.get(), nullptr, &error);
  logAndClear(&error);
  return 0;
}

Evas_Object* ZQVSenderView::_createToolbarButton(Evas_Object* box, const char* text,
                                                 Evas_Smart_Cb clicked) {
  Evas_Object* button = elm_button_add(box);
  if (!button) {
    ZQV_ERROR("elm_button_add btn is NULL");
    return nullptr;
  }
  elm_object_style_set(button, "bottom");
  elm_object_domain_translatable_text_set(button, ZQV_TEXT_DOMAIN, text);
  evas_object_smart_callback_add(button, "clicked", clicked, this);
  setToolbarButtonSize(button);
  evas_object_show(button);
  elm_box_pack_end(box, button);
  return button;
}

void ZQVSenderView::_fillList() {
  const std::string title = _groupTitle();
  Elm_Object_Item* group =
      zqvAppendRow(_list, new WGenlistItemGroup(title.c_str()), nullptr, nullptr);
  elm_genlist_item_select_mode_set(group, ELM_OBJECT_SELECT_MODE_NONE);
  zqvSetAccessibleName(group, title);

  Elm_Object_Item* recipients = zqvAppendRow(
      _list, new WGenlistItemMonoline1Icon(_recipientMarkup().c_str(), _recipientImage.c_str()),
      nullptr, nullptr);
  elm_genlist_item_select_mode_set(recipients, ELM_OBJECT_SELECT_MODE_NONE);
  zqvSetAccessibleName(recipients, _recipientName);
}

std::string ZQVSenderView::_groupTitle() const {
  if (_recipientCount > 1) {
    return zqvFormat("IDS_RSH_HEADER_RECIPIENTS_HPD_ABB", "d", _recipientCount);
  }
  return zqvText("IDS_RSH_HEADER_RECIPIENT");
}

std::string ZQVSenderView::_recipientMarkup() const {
  return zqvEscapeWithin(_recipientName.c_str(), kLongestRowText);
}

/// False when a row has lost its object.
bool ZQVSenderView::_updateRows() {
  Elm_Object_Item* group = _list ? elm_genlist_first_item_get(_list) : nullptr;
  if (!group) return true;
  auto* groupRow = zqvRowOf<WGenlistItemGroup>(elm_object_item_data_get(group));
  if (!groupRow) {
    ZQV_ERROR("itemData is null!");
    return false;
  }
  const std::string title = _groupTitle();
  groupRow->setText(title.c_str());
  elm_genlist_item_update(group);
  zqvSetAccessibleName(group, title);

  Elm_Object_Item* recipients = elm_genlist_item_next_get(group);
  auto* row = recipients ? zqvRowOf<WGenlistItemMonoline1Icon>(elm_object_item_data_get(recipients))
                         : nullptr;
  if (!row) {
    ZQV_ERROR("itemData is null!");
    return false;
  }
  row->setText(_recipientMarkup().c_str());
  row->setImage(_recipientImage.c_str());
  elm_genlist_item_update(recipients);
  zqvSetAccessibleName(recipients, _recipientName);
  return true;
}

void ZQVSenderView::_updateToolbar() {
  if (_recallButton) {
    elm_object_domain_translatable_text_set(_recallButton, ZQV_TEXT_DOMAIN, kRecall);
    setToolbarButtonSize(_recallButton);
  }
  if (_reshareButton) {
    elm_object_domain_translatable_text_set(_reshareButton, ZQV_TEXT_DOMAIN, kReshare);
    setToolbarButtonSize(_reshareButton);
  }
}

bool ZQVSenderView::_checkZelqoStatus(ZQVSenderView* view) {
  switch (view->_accountCheck._checkOvuStatus()) {
    case ZQVAccountCheck::Ok:
      return true;
    case ZQVAccountCheck::SharingIsOff:
      ZQV_ERROR("ZQ NOK!");
      view->_signUp._launchOvuSettingUi();
      return false;
    case ZQVAccountCheck::NoAccount:
      break;
  }
  ZQV_ERROR("Ovu NOK!");
  view->_signUp._launchOvu();
  return false;
}

void ZQVSenderView::_confirmRecall() {
  auto* popup = new app_assist::WPopupController();
  popup->setTextDomain(ZQV_TEXT_DOMAIN);
  popup->setTitle(kRecall);
  popup->setContent("IDS_RSH_POP_THE_RECIPIENT_WILL_NO_LONGER_BE_ABLE_TO_DOWNLOAD_THE_FILES");
  popup->addButton("IDS_RSH_BUTTON_CANCEL_ABB2", [](bool* close) { *close = true; });
  popup->addButton("IDS_RSH_BUTTON_OK", [this](bool* close) {
    *close = true;
    _requestRecall();
  });
  attachPopup(popup);
}

void ZQVSenderView::_requestRecall() {
  _showProcessingPopup();
  if (zelqo_recall_upload(_uploadHandle, _recallUploadCb, _recallTicket.asUserData()) != 0) {
    ZQV_ERROR("zelqo_recall_upload error!");
  }
}

void ZQVSenderView::_showProcessingPopup() {
  if (_processingPopup) evas_object_del(_processingPopup);
  Evas_Object* popup = elm_popup_add(zqvWindowOf(*this));
  _processingPopup = popup;
  evas_object_event_callback_add(popup, EVAS_CALLBACK_DEL, _processingDeletedCb, this);
  evas_object_size_hint_align_set(popup, EVAS_HINT_FILL, 1.0);
  evas_object_size_hint_weight_set(popup, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  elm_popup_orient_set(popup, ELM_POPUP_ORIENT_BOTTOM);
  elm_popup_timeout_set(popup, kRecallTimeout);
  evas_object_smart_callback_add(popup, "timeout", _processingTimeoutCb, nullptr);
  // The toolkit only hides a popup that is closed by key.
  evas_object_smart_callback_add(popup, "dismissed", _processingDismissedCb, nullptr);
  elm_object_content_set(popup, _createProcessingContent(popup));
  evas_object_show(popup);
}

Evas_Object* ZQVSenderView::_createProcessingContent(Evas_Object* popup) {
  Evas_Object* layout = ZQViewerCommon::getInstance().createLayout(popup, "processing_view_layout");
  if (!layout) return nullptr;
  Evas_Object* progress = elm_progressbar_add(layout);
  elm_object_style_set(progress, "process_medium");
  evas_object_size_hint_align_set(progress, EVAS_HINT_FILL, 0.5);
  evas_object_size_hint_weight_set(progress, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  elm_progressbar_pulse_set(progress, EINA_TRUE);
  elm_progressbar_pulse(progress, EINA_TRUE);
  evas_object_show(progress);
  elm_object_part_content_set(layout, "processing", progress);
  elm_object_domain_translatable_part_text_set(layout, "elm.text", ZQV_TEXT_DOMAIN, kRecalling);
  return layout;
}

void ZQVSenderView::_processingTimeoutCb(void*, Evas_Object* popup, void*) {
  evas_object_del(popup);
  zqvPostStatusMessage("IDS_RSH_TPOP_COULDNT_RECALL_FILE_TRY_AGAIN");
}

void ZQVSenderView::_processingDismissedCb(void*, Evas_Object* popup, void*) {
  evas_object_del(popup);
}

void ZQVSenderView::_processingDeletedCb(void* data, Evas*, Evas_Object*, void*) {
  ZQV_TRACE("Protect In EVAS_CALLBACK_DEL!!");
  static_cast<ZQVSenderView*>(data)->_processingPopup = nullptr;
}
