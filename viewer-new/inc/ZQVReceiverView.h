#pragma once

#include <Ecore.h>
#include <app_assist.h>
#include <stdint.h>

#include <set>
#include <string>

#include "ZQVAddressIndex.h"
#include "ZQVDownloadSignals.h"
#include "ZQVGridFiller.h"
#include "ZQVItemGrid.h"
#include "ZQVOwned.h"
#include "ZQVSmartCallback.h"
#include "ZQVWeakObject.h"

class ZQViewerThumbnailItem;

/// The page of a received share: who sent it, how much, until when, and the files with the state of
/// their downloads.
class ZQVReceiverView : public app_assist::WContentViewController {
 public:
  /// `items` is borrowed, the texts are copied; null texts count as empty. `totalSize` in bytes,
  /// `expiry` in milliseconds since the epoch.
  ZQVReceiverView(Eina_List* items, bool isSingleShare, uint64_t totalSize, uint64_t expiry,
                  const char* senderName, const char* contentsToken);

  // WViewController and WContentViewController
  const char* getClassName() override;
  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  void onCreated() override;
  ~ZQVReceiverView() override;
  Elm_Object_Item* onPushToNaviframe(Evas_Object* naviframe) override;
  void onPushed(Elm_Object_Item* item) override;
  bool onPop() override;
  void onBecomeTop() override;

  /// The grid is going away.
  virtual void resetViewType(Evas_Object* grid);

  void setName(const char* name);
  /// Shows all texts again when the language has changed.
  void update(int key);
  /// Markup with files, size, expiry and, for a single share, a hint; freed with g_free.
  char* getSummaryText() const;

  // Called by the toolkit with the view as data.
  static void _gridItemCb(void* data, Evas_Object* grid, void* cell);
  static void _downloadBtnCb(void* data, Evas_Object* button, void* info);
  static void _backButtonCb(void* data, Evas_Object* button, void* info);
  static void _rotateCb(void* data, Evas_Object* window, void* info);

 private:
  static void _gridDeletedCb(void* data, Evas* canvas, Evas_Object* grid, void* info);
  std::string _titleText() const;
  void _nameTitle();
  void _showSummary();
  std::string _expiryLine() const;
  std::string _hint() const;
  void _launchDbusMonitor();
  void _downloadSignalCb(const char* member, const char* url);
  void _redrawLater(ZQViewerThumbnailItem* item);
  static void _redrawCb(void* data);
  void _openFullView(Elm_Object_Item* cell);
  void _openSelectView();
  void _updateToolbarState();
  bool _isAnyToHave() const;
  void _updateCells();
  Evas_Object* _toolbarButton() const;

  Eina_List* _items;
  bool _isSingleShare;
  uint64_t _totalSize;
  uint64_t _expiry;
  ZQVWeakObject _window;
  ZQVWeakObject _label;
  ZQVItemGrid _grid;
  ZQVGridFiller _filler;
  std::string _senderName;
  std::string _contentsToken;
  ZQVSmartCallback _rotation;
  ZQVDownloadSignals _signals;
  ZQVAddressIndex _addresses;
  std::set<ZQViewerThumbnailItem*> _changed;  ///< cells that show an earlier state
  ZQVOwned<Ecore_Job, ecore_job_del> _redraw;
};
