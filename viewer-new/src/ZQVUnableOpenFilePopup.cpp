#include "ZQVUnableOpenFilePopup.h"

#include <system_settings.h>

#include <utility>

#include "ZQVPopupTexts.h"
#include "ZQVText.h"

namespace {

constexpr const char* kTitle = "IDS_RSH_HEADER_UNABLE_TO_OPEN_FILE_ABB";
constexpr const char* kMessage =
    "IDS_RSH_POP_THE_FILE_WAS_DELETED_MOVED_OR_RENAMED_DOWNLOAD_THE_FILE_AND_TRY_AGAIN";

}  // namespace

ZQVUnableOpenFilePopup::ZQVUnableOpenFilePopup(ZQVUnableOpenFilePopup** ownerSlot)
    : _ownerSlot(ownerSlot) {}

ZQVUnableOpenFilePopup::~ZQVUnableOpenFilePopup() {
  _clearOwnerSlot();
}

Evas_Object* ZQVUnableOpenFilePopup::onCreateView(Evas_Object* parent, void* viewParam) {
  setTextDomain(ZQV_TEXT_DOMAIN);
  setTitle(kTitle);
  setContent(kMessage);
  addButton(ZQV_POPUP_CANCEL, [](bool* close) { *close = true; });
  addButton(ZQV_POPUP_DOWNLOAD, [this](bool* close) {
    *close = true;
    const DownloadCb download = _downloadCb;
    bool ignored = true;
    if (download) download(&ignored);
  });
  return WPopupController::onCreateView(parent, viewParam);
}

void ZQVUnableOpenFilePopup::onCreated() {}

Evas_Object* ZQVUnableOpenFilePopup::onViewDeleted(Evas_Object* view) {
  _clearOwnerSlot();
  return view;
}

void ZQVUnableOpenFilePopup::setDownloadCb(DownloadCb callback) {
  _downloadCb = std::move(callback);
}

void ZQVUnableOpenFilePopup::update(int event) {
  if (event != SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE) return;
  Evas_Object* popup = getEvasObj();
  elm_object_domain_translatable_part_text_set(popup, "title,text", ZQV_TEXT_DOMAIN, kTitle);
  elm_object_domain_translatable_text_set(popup, ZQV_TEXT_DOMAIN, kMessage);
  zqvUpdatePopupButtons(popup);
}

void ZQVUnableOpenFilePopup::_clearOwnerSlot() {
  if (_ownerSlot && *_ownerSlot == this) *_ownerSlot = nullptr;
  _ownerSlot = nullptr;
}
