#pragma once

#include <app_assist.h>
#include <stdint.h>

#include <functional>
#include <string>

#include "ZQVWeakObject.h"

/// Asks before a large download: tells its size and offers to wait for Wi-Fi.
class ZQVWifiSelectPopup : public app_assist::WPopupController {
 public:
  /// May close the popup and the page below it.
  using DownloadCb = std::function<void(bool* close)>;

  /// `totalSize` in bytes. `ownerSlot` is the owner's pointer to this popup: it becomes null when
  /// the popup goes away. May be null.
  ZQVWifiSelectPopup(uint64_t totalSize, ZQVWifiSelectPopup** ownerSlot);
  ~ZQVWifiSelectPopup() override;

  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  void onCreated() override;
  Evas_Object* onViewDeleted(Evas_Object* view) override;

  /// The download button leaves the closing of the popup to the callback.
  void setDownloadCb(DownloadCb callback);
  bool isWifiOnly() const;
  void update(int event);
  /// The owner is gone: its pointer is not written any more.
  void forgetOwner() { _ownerSlot = nullptr; }

  static void _wifiCheckChangedCb(void* data, Evas_Object* check, void* info);

 private:
  Evas_Object* _createContent(Evas_Object* popup);
  std::string _sizeMessage() const;
  void _clearOwnerSlot();

  DownloadCb _downloadCb;
  ZQVWifiSelectPopup** _ownerSlot;
  uint64_t _totalSize;
  int32_t _isWifiOnly = 0;
  ZQVWeakObject _label;
  ZQVWeakObject _check;
};
