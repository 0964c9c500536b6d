#pragma once

#include <app_assist.h>
#include <stdint.h>

#include <string>

#include "ZQVAddressIndex.h"
#include "ZQVDownloadSignals.h"
#include "ZQVItemGrid.h"
#include "ZQVNeighbourPictures.h"
#include "ZQVSmartCallback.h"
#include "ZQVTimer.h"
#include "ZQVWeakObject.h"

class ZQVUnableOpenFilePopup;
class ZQVWifiSelectPopup;

/// The files of a share one per page; the file on screen can be downloaded or opened.
class ZQVFullView : public app_assist::WContentViewController {
 public:
  /// `items` is borrowed, the texts are copied; null texts count as empty. `viewKind` is
  /// ZQV_VIEW_FULL_RECEIVER or ZQV_VIEW_FULL_SENDER. Push it with the file to begin with, a
  /// ZQViewerThumbnailItem, as view parameter.
  ZQVFullView(Eina_List* items, int32_t viewKind, const char* sender, const char* token);
  ~ZQVFullView() override;

  const char* getClassName() override;
  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  void onCreated() override;
  Elm_Object_Item* onPushToNaviframe(Evas_Object* naviframe) override;
  void onPushed(Elm_Object_Item* item) override;
  bool onPop() override;

  void setName(const char* name);
  /// Sets all texts again when the language has changed.
  void update(int event);

  // Called by the toolkit with the view as data.
  static void _realizedCb(void* data, Evas_Object* pager, void* cell);
  static void _scrollCb(void* data, Evas_Object* pager, void* info);
  static void _rotateCb(void* data, Evas_Object* window, void* info);
  static void _backButtonCb(void* data, Evas_Object* button, void* info);
  static void fullViewerToolBtnCb(void* data, Evas_Object* button, void* info);
  static bool _delayerSetSize(void* data);
  static void _downloadRequest(ZQVFullView* view, ZQVWifiSelectPopup* popup);

 private:
  bool _isSentShare() const { return _grid.getViewType() == ZQV_VIEW_FULL_SENDER; }
  void _setUpPager();
  static void _resizedCb(void* data, Evas* canvas, Evas_Object* pager, void* info);
  void _takeKeys(Evas_Object* window);
  void _leaveKeys();
  static void _keyCb(void* data, Evas* canvas, Evas_Object* window, void* info);
  void _fitPages();
  Elm_Object_Item* _currentCell() const;
  void _createTitleIcon(Elm_Object_Item* item);
  void _showTitleIcon(const char** frames);
  void _updateDownloadedStatus();
  void _updateSentStatus();
  bool _isInServiceFolder(const ZQViewerThumbnailItem& item) const;
  void _downloadSignalCb(const char* member, const char* url);
  void _markForDownload(ZQViewerThumbnailItem* item);
  void _clearMark();
  void _downloadCurrent();
  void _openCurrent();
  static void _downloadFile(ZQVFullView* view, ZQViewerThumbnailItem* item);
  void _handOver();
  void _askBeforeDownload(uint32_t size);
  void _offerDownloadAgain();
  static void _openFile(const char* path);
  ZQViewerThumbnailItem* _itemOfPage(int page) const;

  Eina_List* _items;
  std::string _sender;
  std::string _token;
  ZQVItemGrid _grid;
  ZQVNeighbourPictures _neighbours;
  ZQViewerThumbnailItem* _passedItem = nullptr;
  ZQViewerThumbnailItem* _curItem = nullptr;
  ZQViewerThumbnailItem* _markedItem = nullptr;
  int32_t _currentPage = -1;
  Eina_Bool _isMirrored = EINA_FALSE;
  bool _isWifiOnly = false;
  ZQVUnableOpenFilePopup* _unablePopup = nullptr;
  ZQVWifiSelectPopup* _wifiPopup = nullptr;
  ZQVWeakObject _window;
  ZQVWeakObject _toolButton;
  ZQVWeakObject _titleLayout;
  const char** _titleFrames = nullptr;
  ZQVTimer _delayer;
  ZQVSmartCallback _rotation;
  ZQVAddressIndex _addresses;
  ZQVDownloadSignals _signals;
};
