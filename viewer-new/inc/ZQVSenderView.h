#pragma once

#include <app_assist.h>
#include <stdint.h>

#include <string>

#include "ZQVAccountCheck.h"
#include "ZQVGridFiller.h"
#include "ZQVItemGrid.h"
#include "ZQVSignUpLaunch.h"
#include "ZQVSmartCallback.h"
#include "ZQVTicket.h"
#include "ZQVWeakObject.h"

/// The first page for the sender of a share: recipients, files, recall and reshare; or, for files
/// handed over by a messaging application, the files alone.
class ZQVSenderView : public app_assist::WContentViewController {
 public:
  /// `items` is borrowed, the texts are copied; null texts count as empty. `firstFlag` is handed on
  /// to reshare as it is. `uploadHandle` is the share's request id.
  ZQVSenderView(Eina_List* items, bool firstFlag, bool isGridOnly, uint32_t uploadHandle,
                const char* recipientName, int32_t recipientCount, const char* recipientImage);
  ~ZQVSenderView() override;

  const char* getClassName() override;
  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  void onCreated() override;
  Elm_Object_Item* onPushToNaviframe(Evas_Object* naviframe) override;
  void onPushed(Elm_Object_Item* item) override;
  bool onPop() override;

  /// Keeps a clone of the request that started the application.
  void setLaunchRequest(app_control_h request);
  /// The recipients' names and picture have changed; shown by the next update.
  void setRecipients(const char* text, const char* imagePath);
  /// Sets all texts again when the language has changed.
  void update(int event);

  // Called by the toolkit and the sharing service with the view as data.
  static void _gridItemCb(void* data, Evas_Object* grid, void* cell);
  static void _rotateCb(void* data, Evas_Object* window, void* info);
  static void _recallBtnCb(void* data, Evas_Object* button, void* info);
  static void _reshareBtnCb(void* data, Evas_Object* button, void* info);
  /// Here the data is the view's ticket: an answer may come after the view.
  static void _recallUploadCb(int error, void* data);
  /// 0 when the signal was written to the system bus, else -1.
  static int _sendDbusSignalToHistory(ZQVSenderView* view, const char* member, const char* value);

 private:
  Evas_Object* _createToolbarButton(Evas_Object* box, const char* text, Evas_Smart_Cb clicked);
  void _fillList();
  std::string _groupTitle() const;
  std::string _recipientMarkup() const;
  bool _updateRows();
  void _updateToolbar();
  static bool _checkZelqoStatus(ZQVSenderView* view);
  void _confirmRecall();
  void _requestRecall();
  void _showProcessingPopup();
  Evas_Object* _createProcessingContent(Evas_Object* popup);
  static void _processingTimeoutCb(void* data, Evas_Object* popup, void* info);
  static void _processingDismissedCb(void* data, Evas_Object* popup, void* info);
  static void _processingDeletedCb(void* data, Evas* canvas, Evas_Object* popup, void* info);

  Eina_List* _items;
  ZQVItemGrid _grid;
  Evas_Object* _processingPopup = nullptr;
  bool _firstFlag;
  bool _isGridOnly;
  uint32_t _uploadHandle;
  std::string _recipientName;
  int32_t _recipientCount;
  std::string _recipientImage;
  ZQVWeakObject _list;
  ZQVWeakObject _recallButton;
  ZQVWeakObject _reshareButton;
  ZQVGridFiller _filler;
  ZQVAccountCheck _accountCheck;
  ZQVSignUpLaunch _signUp;
  ZQVTicket _recallTicket{this};
  ZQVSmartCallback _rotation;
};
