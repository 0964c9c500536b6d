#include "ZQVApp.h"

#include <app_common.h>
#include <contacts.h>
#include <ui-gadget.h>

#include <cstring>
#include <ctime>
#include <vector>

#include "ZQVCommon.h"
#include "ZQVContacts.h"
#include "ZQVExpiredView.h"
#include "ZQVFullView.h"
#include "ZQVLaunchRequest.h"
#include "ZQVLocalList.h"
#include "ZQVLog.h"
#include "ZQVOrlantLog.h"
#include "ZQVOwned.h"
#include "ZQVReceivedList.h"
#include "ZQVReceiverView.h"
#include "ZQVSelectView.h"
#include "ZQVSenderView.h"
#include "ZQVThumbItem.h"

using app_assist::WContentViewController;
using app_assist::WNaviframeController;
using app_assist::WWindowController;

namespace {

/// What makes the pages show their texts anew.
constexpr int kTextsChanged = SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE;
constexpr system_settings_key_e kWatchedSettings[] = {SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR,
                                                      SYSTEM_SETTINGS_KEY_TIME_CHANGED,
                                                      SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE};

std::string sharedResource(const char* name) {
  const ZQVPlatformText shared(app_get_shared_resource_path());
  char path[512] = {};
  g_snprintf(path, sizeof path, "%s%s", shared ? shared.get() : "", name);
  return path;
}

/// The paths of a sent share's files; one that cannot be read is empty and null.
std::vector<ZQVOwnedText> sentPaths(zelqo_share_h handle, unsigned int count) {
  std::vector<ZQVOwnedText> paths(count);
  for (unsigned int i = 0; i < count; ++i) {
    ZQVPlatformText path;
    const int result = zelqo_upload_info_get_content_file_path(handle, i, path.out());
    if (result != ZELQO_ERROR_NONE) {
      ZQV_ERROR("Unexpected SAPI error(get SAPI file path failed)!");
    } else if (!path) {
      ZQV_ERROR("filePath is NULL");
    } else {
      paths[i].reset(g_strdup(path.get()));
    }
  }
  return paths;
}

template <typename Owner>
std::vector<const char*> textsOf(const std::vector<Owner>& owners) {
  std::vector<const char*> texts;
  texts.reserve(owners.size());
  for (const auto& owner : owners) texts.push_back(owner.get());
  return texts;
}

void updateView(const std::string& className, WContentViewController* view, int key) {
  if (className == "ZQVSenderView") {
    static_cast<ZQVSenderView*>(view)->update(key);
  } else if (className == "ZQVReceiverView") {
    static_cast<ZQVReceiverView*>(view)->update(key);
  } else if (className == "ZQVSelectView") {
    static_cast<ZQVSelectView*>(view)->update(key);
  } else if (className == "ZQVFullView") {
    static_cast<ZQVFullView*>(view)->update(key);
  } else if (className == "ZQVExpiredView") {
    static_cast<ZQVExpiredView*>(view)->update(key);
  }
}

void setSenderName(const std::string& className, WContentViewController* view, const char* name) {
  if (className == "ZQVReceiverView") {
    static_cast<ZQVReceiverView*>(view)->setName(name);
  } else if (className == "ZQVSelectView") {
    static_cast<ZQVSelectView*>(view)->setName(name);
  } else if (className == "ZQVFullView") {
    static_cast<ZQVFullView*>(view)->setName(name);
  } else if (className == "ZQVExpiredView") {
    static_cast<ZQVExpiredView*>(view)->setName(name);
  }
}

}  // namespace

ZQVApp::ZQVApp(int argc, char** argv) : WApp(argc, argv) {}

ZQVApp::~ZQVApp() = default;

bool ZQVApp::onCreate() {
  elm_app_base_scale_set(2.6);
  _createWindow();
  uxt_theme_set_changeable_ui_enabled(true);
  edje_color_class_set("W156", 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0);
  _loadTables();
  const int result = contacts_connect();
  if (result != CONTACTS_ERROR_NONE) ZQV_ERROR("contacts_connect failed : error = %d", result);
  contacts_db_add_changed_cb(_contacts_person._uri, _onContactChanged, this);
  _loadTheme();
  for (const auto key : kWatchedSettings) {
    system_settings_set_changed_cb(key, _settingsChangedCb, this);
  }
  return true;
}

void ZQVApp::_createWindow() {
  auto* controller = new WWindowController("zelqo-viewer", ELM_WIN_BASIC);
  attachWindowController(controller);
  UG_INIT_EFL(_window(), UG_OPT_INDICATOR_ENABLE);
  auto* naviframe = new WNaviframeController;
  naviframe->setOnLastItemPop([](bool* handled) {
    *handled = true;
    elm_exit();
  });
  controller->attachBaseViewController(naviframe);
  elm_win_indicator_mode_set(_window(), ELM_WIN_INDICATOR_SHOW);
  elm_win_indicator_opacity_set(_window(), ELM_WIN_INDICATOR_TRANSPARENT);
}

void ZQVApp::_loadTables() {
  const std::string colors = sharedResource("tables/com.orlant.zelqo_ChangeableColorTable.xml");
  const std::string fonts = sharedResource("tables/com.orlant.zelqo_FontInfoTable.xml");
  _colorTable = uxt_theme_add_color_table(colors.c_str());
  _fontTable = uxt_theme_add_font_table(fonts.c_str());
  uxt_theme_set_color_table(_colorTable);
  uxt_theme_set_font_table(_fontTable);
}

void ZQVApp::_loadTheme() {
  _theme = elm_theme_new();
  elm_theme_ref_set(_theme, nullptr);
  elm_theme_extension_add(_theme, zqvThemeFile().c_str());
}

void ZQVApp::onTerminate() {
  contacts_db_remove_changed_cb(_contacts_person._uri, _onContactChanged, this);
  const int result = contacts_disconnect();
  if (result != CONTACTS_ERROR_NONE) {
    ZQV_ERROR("contacts_svc_disconnect failed : ct_err = [%d]", result);
  }
  _clearList();
  _thumbnails.stopWatchdogs();
  uxt_theme_delete_color_table(_colorTable);
  uxt_theme_delete_font_table(_fontTable);
  _colorTable = nullptr;
  _fontTable = nullptr;
  if (_theme) {
    elm_theme_extension_del(_theme, zqvThemeFile().c_str());
    elm_theme_free(_theme);
    _theme = nullptr;
  }
  for (const auto key : kWatchedSettings) system_settings_unset_changed_cb(key);
}

void ZQVApp::onPause() {}

void ZQVApp::onResume() {}

Evas_Object* ZQVApp::_window() const {
  return getWindowController()->getEvasObj();
}

WNaviframeController* ZQVApp::_naviframe() const {
  return static_cast<WNaviframeController*>(getWindowController()->getBaseViewController());
}

void ZQVApp::onAppControl(app_control_h request) {
  if (!request) {
    ZQV_ERROR("request is NULL");
    return;
  }
  if (!ZQVLaunchRequest::isForViewer(request)) return;
  _request = request;
  const ZQVLaunchRequest launch(request);
  _isSingleShare = launch.isSingleShare();
  _naviframe()->destroyAllViewControllers();
  elm_win_activate(_window());
  if (launch.viewType()) {
    _launchByViewType(launch);
  } else if (launch.contentsToken()) {
    _launchByContentsToken(launch);
  } else {
    _launchByFiles(launch);
  }
  _request = nullptr;
}

void ZQVApp::_launchByViewType(const ZQVLaunchRequest& launch) {
  _requestId = launch.requestId();
  if (strcmp(launch.viewType(), "sent") == 0) {
    if (_thumbList) _clearList();
    ZQVOrlantLog::getInstance().insertEntryPath(_request, ZQV_ENTRY_SENT);
    _launchSenderViewSentData();
  } else if (strcmp(launch.viewType(), "received") == 0) {
    if (_thumbList) _clearList();
    _forgetRecipients();
    _contentsToken = launch.contentsToken() ? launch.contentsToken() : "";
    ZQVOrlantLog::getInstance().insertEntryPath(_request, ZQV_ENTRY_RECEIVED);
    _launchReceiverViewBySharedData(_naviframe());
  } else {
    ZQV_ERROR("viewType error");
  }
}

/// The list of the share before stays until the new one is built; an expired share needs none.
void ZQVApp::_launchByContentsToken(const ZQVLaunchRequest& launch) {
  _forgetRecipients();
  _contentsToken = launch.contentsToken();
  _launchReceiverViewBySharedData(_naviframe());
  ZQVOrlantLog::getInstance().insertEntryPath(_request, ZQV_ENTRY_RECEIVED);
}

void ZQVApp::_launchByFiles(const ZQVLaunchRequest& launch) {
  if (_thumbList) _clearList();
  _forgetRecipients();
  const auto files = launch.files();
  _fileCount = static_cast<uint32_t>(files.size());
  const std::vector<const char*> paths = textsOf(files);
  _initListByAppControl(paths.data(), static_cast<int>(paths.size()));
  _naviframe()->push(new ZQVSenderView(_thumbList, false, true, 0, nullptr, 1, nullptr));
  ZQVOrlantLog::getInstance().insertEntryPath(_request, ZQV_ENTRY_SENT);
}

void ZQVApp::_launchReceiverViewBySharedData(WNaviframeController* naviframe) {
  if (!naviframe) {
    ZQV_ERROR("data is NULL");
    return;
  }
  zelqo_share_h handle = nullptr;
  if (!_readReceivedShare(&handle)) return;
  const auto now = static_cast<uint64_t>(time(nullptr));
  if (_expiredTime / 1000 < now) {
    _showExpired(naviframe);
  } else {
    _showReceived(naviframe, handle);
  }
}

bool ZQVApp::_readReceivedShare(zelqo_share_h* handle) {
  if (zelqo_push_info_get_handle(_contentsToken.c_str(), handle) != ZELQO_ERROR_NONE) {
    ZQV_ERROR("Unexpected SAPI error(get SAPI handle failed)!");
    ZQViewerCommon::getInstance().safeExit(_window());
    return false;
  }
  _senderMsisdn = nullptr;
  if (zelqo_push_info_get_sender_msisdn(*handle, &_senderMsisdn) != ZELQO_ERROR_NONE ||
      !_senderMsisdn) {
    ZQV_ERROR("get sender msisdn failed!");
    return false;
  }
  _senderName = ZQVContacts::nameOrNumber(_senderMsisdn);
  if (zelqo_push_info_get_content_info_count(*handle, &_fileCount) != ZELQO_ERROR_NONE) {
    ZQV_ERROR("get count failed");
    return false;
  }
  _sumFileSizes(*handle);
  unsigned long long expiredTime = 0;
  if (zelqo_push_info_get_expired_time(*handle, &expiredTime) != ZELQO_ERROR_NONE) {
    ZQV_ERROR("get expired time failed");
    return false;
  }
  _expiredTime = expiredTime;
  return true;
}

void ZQVApp::_sumFileSizes(zelqo_share_h handle) {
  _totalSize = 0;
  for (uint32_t i = 0; i < _fileCount; ++i) {
    unsigned int size = 0;
    zelqo_content_info_get_file_size(handle, i, &size);
    if (size == 0) ZQV_ERROR("index : %u, fileSize is 0!", i);
    _totalSize += size;
  }
}

void ZQVApp::_showExpired(WNaviframeController* naviframe) {
  naviframe->push(new ZQVExpiredView(_totalSize, _expiredTime, static_cast<int>(_fileCount),
                                     _senderName.c_str()));
}

void ZQVApp::_showReceived(WNaviframeController* naviframe, zelqo_share_h handle) {
  _initListBySAPI(handle);
  naviframe->push(new ZQVReceiverView(_thumbList, _isSingleShare, _totalSize, _expiredTime,
                                      _senderName.c_str(), _contentsToken.c_str()));
  _thumbnails.setShare(_thumbList, _contentsToken.c_str());
  _thumbnails._getContentInfoNReqNormalThumbnail(handle);
  _thumbnails._reqMidThumbnail(handle);
}

void ZQVApp::_launchSenderViewSentData() {
  WNaviframeController* naviframe = _naviframe();
  _forgetRecipients();
  zelqo_share_h handle = nullptr;
  if (zelqo_upload_info_get_handle(_requestId, &handle) != ZELQO_ERROR_NONE) {
    ZQV_ERROR("Unexpected SAPI error(get SAPI handle failed)!");
    ZQViewerCommon::getInstance().safeExit(_window());
    return;
  }
  if (zelqo_upload_info_get_recipient_msisdn_list(handle, &_recipientList, &_recipientCount) !=
      ZELQO_ERROR_NONE) {
    ZQV_ERROR("Unexpected SAPI error(get SAPI msisdn list failed)!");
    _forgetRecipients();
  }
  const std::string recipients = ZQVContacts::recipientsText(_recipientList, _recipientCount);
  const std::string image = ZQVContacts::recipientsImage(_recipientList, _recipientCount);
  unsigned int count = 0;
  if (zelqo_upload_info_get_content_info_count(handle, &count) != ZELQO_ERROR_NONE) {
    ZQV_ERROR("Unexpected SAPI error(get SAPI count failed)!");
    count = 0;
  }
  const std::vector<ZQVOwnedText> paths = sentPaths(handle, count);
  _initListByAppControl(textsOf(paths).data(), static_cast<int>(count));
  auto* view = new ZQVSenderView(_thumbList, count > 1, false, _requestId, recipients.c_str(),
                                 static_cast<int>(_recipientCount), image.c_str());
  view->setLaunchRequest(_request);
  naviframe->push(view);
}

void ZQVApp::_initListBySAPI(zelqo_share_h handle) {
  if (_thumbList) _clearList();
  _fileCount -= ZQVReceivedList::append(handle, _fileCount, &_thumbList);
}

void ZQVApp::_initListByAppControl(const char* const* paths, int count) {
  ZQVLocalList::append(paths, count, &_thumbList, &_totalSize);
}

void ZQVApp::_clearList() {
  _thumbnails.forgetShare();
  const Eina_List* node = nullptr;
  void* item = nullptr;
  EINA_LIST_FOREACH(_thumbList, node, item) delete static_cast<ZQViewerThumbnailItem*>(item);
  _thumbList = eina_list_remove_list(_thumbList, _thumbList);
  // One less than the items that were released: the head is off the list by now.
  ZQV_TRACE("eina_list_count(_thumbList):%d", static_cast<int>(eina_list_count(_thumbList)));
  _thumbList = eina_list_free(_thumbList);
}

void ZQVApp::_forgetRecipients() {
  _recipientList = nullptr;
  _recipientCount = 0;
}

void ZQVApp::_forEachView(const ViewVisitor& visit) {
  Eina_List* items = elm_naviframe_items_get(_naviframe()->getEvasObj());
  void* item = nullptr;
  EINA_LIST_FREE(items, item) {
    auto* view = static_cast<WContentViewController*>(
        elm_object_item_data_get(static_cast<Elm_Object_Item*>(item)));
    if (!view) {
      ZQV_ERROR("view is null!");
      break;
    }
    const char* className = view->getClassName();
    if (!className) {
      ZQV_ERROR("className is null!");
      break;
    }
    visit(className, view);
  }
  eina_list_free(items);
}

void ZQVApp::_settingsChangedCb(system_settings_key_e key, void* user_data) {
  if (!user_data) {
    ZQV_ERROR("data is null!");
    return;
  }
  static_cast<ZQVApp*>(user_data)->_forEachView(
      [key](const std::string& className, WContentViewController* view) {
        updateView(className, view, key);
      });
}

void ZQVApp::_onContactChanged(const char*, void* app) {
  if (!app) {
    ZQV_ERROR("Invalid Param : data");
    return;
  }
  static_cast<ZQVApp*>(app)->_showNamesAgain();
}

void ZQVApp::_showNamesAgain() {
  const std::string recipients = ZQVContacts::recipientsText(_recipientList, _recipientCount);
  const std::string image = ZQVContacts::recipientsImage(_recipientList, _recipientCount);
  if (_recipientCount == 0 && _senderMsisdn) {
    _senderName = ZQVContacts::nameOrNumber(_senderMsisdn);
  }
  _forEachView([&](const std::string& className, WContentViewController* view) {
    if (className == "ZQVSenderView") {
      static_cast<ZQVSenderView*>(view)->setRecipients(recipients.c_str(), image.c_str());
    } else {
      setSenderName(className, view, _senderName.c_str());
    }
    updateView(className, view, kTextsChanged);
  });
}
