#pragma once

#include <app_assist.h>
#include <stdint.h>
#include <system_settings.h>
#include <uxt_theme.h>
#include <zelqo.h>

#include <functional>
#include <string>

#include "ZQVThumbnailFetcher.h"

class ZQVLaunchRequest;

/// The viewer: turns a launch request into the list of shared files and its first page, and keeps
/// what the pages show current.
class ZQVApp : public app_assist::WApp {
 public:
  ZQVApp(int argc, char** argv);
  ~ZQVApp() override;

  bool onCreate() override;
  void onTerminate() override;
  void onPause() override;
  void onResume() override;
  void onAppControl(app_control_h request) override;

 private:
  using ViewVisitor =
      std::function<void(const std::string& className, app_assist::WContentViewController* view)>;

  void _createWindow();
  void _loadTables();
  void _loadTheme();
  Evas_Object* _window() const;
  app_assist::WNaviframeController* _naviframe() const;

  void _launchByViewType(const ZQVLaunchRequest& launch);
  void _launchByContentsToken(const ZQVLaunchRequest& launch);
  void _launchByFiles(const ZQVLaunchRequest& launch);
  void _launchReceiverViewBySharedData(app_assist::WNaviframeController* naviframe);
  void _launchSenderViewSentData();
  bool _readReceivedShare(zelqo_share_h* handle);
  void _sumFileSizes(zelqo_share_h handle);
  void _showExpired(app_assist::WNaviframeController* naviframe);
  void _showReceived(app_assist::WNaviframeController* naviframe, zelqo_share_h handle);

  void _initListBySAPI(zelqo_share_h handle);
  void _initListByAppControl(const char* const* paths, int count);
  void _clearList();
  void _forgetRecipients();

  void _forEachView(const ViewVisitor& visit);
  static void _settingsChangedCb(system_settings_key_e key, void* user_data);
  static void _onContactChanged(const char* viewUri, void* app);
  void _showNamesAgain();

  Eina_List* _thumbList = nullptr;
  uint64_t _totalSize = 0;  ///< bytes
  uint32_t _fileCount = 0;
  uint64_t _expiredTime = 0;  ///< milliseconds since the epoch
  zelqo_recipient_s** _recipientList = nullptr;
  uint32_t _recipientCount = 0;
  char* _senderMsisdn = nullptr;
  std::string _senderName;
  std::string _contentsToken;
  bool _isSingleShare = false;
  int32_t _requestId = 0;
  uxt_theme_color_table_h _colorTable = nullptr;
  uxt_theme_font_table_h _fontTable = nullptr;
  Elm_Theme* _theme = nullptr;
  ZQVThumbnailFetcher _thumbnails;
  app_control_h _request = nullptr;  ///< the request being handled, valid during onAppControl only
};
