#pragma once

#include <app_assist.h>
#include <stdint.h>

#include <string>

#include "ZQVWeakObject.h"

/// The page of a received share that can no longer be downloaded.
class ZQVExpiredView : public app_assist::WContentViewController {
 public:
  /// `totalSize` in bytes, `expiry` in milliseconds since the epoch; a null name counts as empty.
  ZQVExpiredView(uint64_t totalSize, uint64_t expiry, int32_t fileCount, const char* senderName);

  // WViewController and WContentViewController
  const char* getClassName() override;
  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  ~ZQVExpiredView() override;
  Elm_Object_Item* onPushToNaviframe(Evas_Object* naviframe) override;
  void onPushed(Elm_Object_Item* item) override;

  void setName(const char* name);
  /// Shows all texts again when the language has changed.
  void update(int event);
  /// Two lines: files and size, and the day; freed with g_free.
  char* getSummaryText() const;

  // Called by the toolkit with the view as data.
  static void _backTitleButtonPressedCb(void* data, Evas_Object* button, void* info);

 private:
  std::string _titleText() const;
  void _nameTitle();
  std::string _dateText() const;
  void _showTexts();

  ZQVWeakObject _textLabel;
  ZQVWeakObject _messageLabel;
  uint64_t _totalSize;
  uint64_t _expiry;
  int32_t _fileCount;
  std::string _senderName;
};
