#pragma once

#include <app_assist.h>

#include <functional>

/// Says that a downloaded file is not where it was saved and offers to download it again.
class ZQVUnableOpenFilePopup : public app_assist::WPopupController {
 public:
  using DownloadCb = std::function<void(bool* close)>;

  /// `ownerSlot` is the owner's pointer to this popup: it becomes null when the popup goes away.
  /// May be null.
  explicit ZQVUnableOpenFilePopup(ZQVUnableOpenFilePopup** ownerSlot);
  ~ZQVUnableOpenFilePopup() override;

  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  void onCreated() override;
  Evas_Object* onViewDeleted(Evas_Object* view) override;

  /// Unlike the large-download popup, this one closes whatever the callback does.
  void setDownloadCb(DownloadCb callback);
  void update(int event);
  /// The owner is gone: its pointer is not written any more.
  void forgetOwner() { _ownerSlot = nullptr; }

 private:
  void _clearOwnerSlot();

  ZQVUnableOpenFilePopup** _ownerSlot;
  DownloadCb _downloadCb;
};
