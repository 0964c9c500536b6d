#pragma once

#include <app_assist.h>

#include <string>

#include "ZQVItemGrid.h"
#include "ZQVSmartCallback.h"
#include "ZQVWeakObject.h"

class WGenlistItemMonoline1Check;
class ZQVWifiSelectPopup;

/// The page on which a recipient picks the files to download.
class ZQVSelectView : public app_assist::WContentViewController {
 public:
  /// `items` is borrowed, the texts are copied; null texts count as empty.
  ZQVSelectView(Eina_List* items, const char* senderName, const char* contentsToken);
  ~ZQVSelectView() override;

  const char* getClassName() override;
  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  void onCreated() override;
  void onPushed(Elm_Object_Item* item) override;
  bool onPop() override;

  void setName(const char* name);
  /// Sets all texts again when the language has changed.
  void update(int event);

  // Called by the toolkit with the view as data.
  static void _gridItemCb(void* data, Evas_Object* grid, void* cell);
  static void _listItemCb(void* data, Evas_Object* list, void* row);
  static void _doneBtnCb(void* data, Evas_Object* button, void* info);
  static void _cancelBtnCb(void* data, Evas_Object* button, void* info);
  static void _rotateCb(void* data, Evas_Object* window, void* info);

 private:
  Evas_Object* _createTitleButton(const char* style, const char* text, Evas_Smart_Cb clicked);
  void _toggleItem(Elm_Object_Item* cell);
  void _toggleAll(WGenlistItemMonoline1Check* row);
  void _downloadSelected();
  void _askBeforeDownload(uint64_t totalSize);
  void _downloadRequest(const ZQVWifiSelectPopup* popup);
  static void _downloadFile(ZQVSelectView* view);
  WGenlistItemMonoline1Check* _selectAllRow() const;
  void _nameSelectAllRow();
  void _nameCell(const ZQViewerThumbnailItem& item);
  void _nameCells();
  void _clearChecks();
  void _showSelectedCount();
  void _setTitleText(const char* text);

  ZQVItemGrid _grid;
  ZQVWeakObject _list;
  Eina_List* _items;
  int32_t _selectableCount = 0;
  int32_t _selectedCount = 0;
  std::string _sender;
  std::string _token;
  bool _isWifiOnly = false;
  bool _isHandedOver = false;
  ZQVWifiSelectPopup* _wifiPopup = nullptr;
  ZQVWeakObject _doneButton;
  ZQVSmartCallback _rotation;
};
