#include "ZQVWifiSelectPopup.h"

#include <system_settings.h>

#include <utility>

#include "ZQVCommon.h"
#include "ZQVLog.h"
#include "ZQVPopupTexts.h"
#include "ZQVSizeText.h"
#include "ZQVText.h"

namespace {

constexpr const char* kTitle = "IDS_RSH_HEADER_DOWNLOAD_FILES";
constexpr const char* kWifiOnly = "IDS_RSH_OPT_DOWNLOAD_VIA_WI_FI_ONLY_ABB";
constexpr const char* kFileGone =
    "IDS_RSH_POP_THE_FILE_WAS_DELETED_MOVED_OR_RENAMED_DOWNLOAD_THE_FILE_AND_TRY_AGAIN";

}  // namespace

ZQVWifiSelectPopup::ZQVWifiSelectPopup(uint64_t totalSize, ZQVWifiSelectPopup** ownerSlot)
    : _ownerSlot(ownerSlot), _totalSize(totalSize) {}

ZQVWifiSelectPopup::~ZQVWifiSelectPopup() {
  _clearOwnerSlot();
}

Evas_Object* ZQVWifiSelectPopup::onCreateView(Evas_Object* parent, void* viewParam) {
  setTextDomain(ZQV_TEXT_DOMAIN);
  setTitle(kTitle);
  setContent([this](Evas_Object* popup) { return _createContent(popup); });
  addButton(ZQV_POPUP_CANCEL, [](bool* close) { *close = true; });
  addButton(ZQV_POPUP_DOWNLOAD, [this](bool* close) {
    *close = false;
    // The callback may take this popup and its page down, so it runs from a copy, and last.
    const DownloadCb download = _downloadCb;
    bool ignored = false;
    if (download) download(&ignored);
  });
  return WPopupController::onCreateView(parent, viewParam);
}

void ZQVWifiSelectPopup::onCreated() {}

Evas_Object* ZQVWifiSelectPopup::onViewDeleted(Evas_Object* view) {
  _clearOwnerSlot();
  return view;
}

void ZQVWifiSelectPopup::setDownloadCb(DownloadCb callback) {
  _downloadCb = std::move(callback);
}

bool ZQVWifiSelectPopup::isWifiOnly() const {
  return _isWifiOnly != 0;
}

void ZQVWifiSelectPopup::update(int event) {
  if (event != SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE) return;
  Evas_Object* popup = getEvasObj();
  elm_object_domain_translatable_part_text_set(popup, "title,text", ZQV_TEXT_DOMAIN, kTitle);
  // From here on the label tells this instead of the size; that is intended.
  if (_label) elm_object_domain_translatable_text_set(_label, ZQV_TEXT_DOMAIN, kFileGone);
  if (_check) elm_object_domain_translatable_text_set(_check, ZQV_TEXT_DOMAIN, kWifiOnly);
  zqvUpdatePopupButtons(popup);
}

void ZQVWifiSelectPopup::_wifiCheckChangedCb(void* data, Evas_Object* check, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  static_cast<ZQVWifiSelectPopup*>(data)->_isWifiOnly = elm_check_state_get(check) ? 1 : 0;
}

Evas_Object* ZQVWifiSelectPopup::_createContent(Evas_Object* popup) {
  Evas_Object* layout = ZQViewerCommon::getInstance().createLayout(popup, "popup_checkview_layout");
  if (!layout) return nullptr;

  _label = elm_label_add(layout);
  elm_object_style_set(_label, "popup/default");
  elm_label_line_wrap_set(_label, ELM_WRAP_MIXED);
  elm_object_text_set(_label, _sizeMessage().c_str());
  evas_object_size_hint_weight_set(_label, EVAS_HINT_EXPAND, 0.0);
  evas_object_size_hint_align_set(_label, EVAS_HINT_FILL, EVAS_HINT_FILL);
  evas_object_show(_label);
  elm_object_part_content_set(layout, "elm.swallow.end", _label);

  _check = elm_check_add(layout);
  elm_object_style_set(_check, "popup");
  elm_object_domain_translatable_text_set(_check, ZQV_TEXT_DOMAIN, kWifiOnly);
  evas_object_smart_callback_add(_check, "changed", _wifiCheckChangedCb, this);
  evas_object_show(_check);
  elm_object_part_content_set(layout, "elm.swallow.check", _check);
  return layout;
}

std::string ZQVWifiSelectPopup::_sizeMessage() const {
  const ZQVSizeText size(_totalSize);
  return zqvFormat("IDS_RSH_POP_THE_TOTAL_FILE_SIZE_IS_OVER_P1SS_P2SS_TO_AVOID_MSG", "ss",
                   size.number, size.unit.get());
}

void ZQVWifiSelectPopup::_clearOwnerSlot() {
  if (_ownerSlot && *_ownerSlot == this) *_ownerSlot = nullptr;
  _ownerSlot = nullptr;
}
