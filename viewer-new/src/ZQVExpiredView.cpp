#include "ZQVExpiredView.h"

#include <system_settings.h>

#include <cstdlib>
#include <ctime>

#include "ZQVAccess.h"
#include "ZQVCommon.h"
#include "ZQVLog.h"
#include "ZQVMarkup.h"
#include "ZQVOwned.h"
#include "ZQVSizeText.h"
#include "ZQVText.h"
#include "ZQVWindow.h"

namespace {

constexpr size_t kTextLimit = 512;
constexpr const char* kTitle = "IDS_RSH_HEADER_FILES_SHARED_BY_PS_ABB";
constexpr const char* kDownloadText = "IDS_RSH_BUTTON_DOWNLOAD_ABB3";

Evas_Object* createLabel(Evas_Object* layout, const char* part) {
  Evas_Object* label = elm_label_add(layout);
  elm_object_style_set(label, "popup/default");
  elm_label_line_wrap_set(label, ELM_WRAP_MIXED);
  evas_object_size_hint_weight_set(label, EVAS_HINT_EXPAND, 0.0);
  evas_object_size_hint_align_set(label, EVAS_HINT_FILL, EVAS_HINT_FILL);
  elm_object_part_content_set(layout, part, label);
  return label;
}

}  // namespace

ZQVExpiredView::ZQVExpiredView(uint64_t totalSize, uint64_t expiry, int32_t fileCount,
                               const char* senderName)
    : _totalSize(totalSize),
      _expiry(expiry),
      _fileCount(fileCount),
      _senderName(senderName ? senderName : "") {}

ZQVExpiredView::~ZQVExpiredView() = default;

const char* ZQVExpiredView::getClassName() {
  return "ZQVExpiredView";
}

Evas_Object* ZQVExpiredView::onCreateView(Evas_Object* parent, void*) {
  if (!parent) {
    ZQV_ERROR("parent is NULL");
    return nullptr;
  }
  setTitle(_titleText().c_str());
  Evas_Object* scroller = elm_scroller_add(parent);
  zqvColorPage(scroller);
  Evas_Object* layout = ZQViewerCommon::getInstance().createLayout(
      scroller, "expired_viewer_shared_file_thumbnail_layout");
  _textLabel = createLabel(layout, "elm.swallow.label.text");
  _messageLabel = createLabel(layout, "elm.swallow.label.message");
  _showTexts();
  elm_object_content_set(scroller, layout);
  return scroller;
}

Elm_Object_Item* ZQVExpiredView::onPushToNaviframe(Evas_Object* naviframe) {
  Evas_Object* back = zqvAddBackButton(naviframe, _backTitleButtonPressedCb, this);
  return elm_naviframe_item_push(naviframe, getTitle(), back, nullptr, getEvasObj(), nullptr);
}

void ZQVExpiredView::onPushed(Elm_Object_Item* item) {
  if (*getTitle()) elm_object_item_domain_text_translatable_set(item, ZQV_TEXT_DOMAIN, EINA_TRUE);
  _nameTitle();
  Evas_Object* download = elm_button_add(elm_object_item_widget_get(item));
  elm_object_style_set(download, "bottom");
  elm_object_domain_translatable_text_set(download, ZQV_TEXT_DOMAIN, kDownloadText);
  elm_object_item_part_content_set(item, "toolbar", download);
  elm_object_disabled_set(download, EINA_TRUE);
}

void ZQVExpiredView::setName(const char* name) {
  _senderName = name ? name : "";
}

void ZQVExpiredView::update(int event) {
  if (event != SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE) return;
  Elm_Object_Item* item = getNaviItem();
  const std::string title = _titleText();
  setTitle(title.c_str());
  if (!title.empty()) {
    elm_object_item_domain_translatable_text_set(item, ZQV_TEXT_DOMAIN, title.c_str());
  }
  _nameTitle();
  _showTexts();
  Evas_Object* download = item ? elm_object_item_part_content_get(item, "toolbar") : nullptr;
  if (!download) {
    ZQV_ERROR("toolbar part object is null!");
    return;
  }
  // The id, not what it reads now: else the button would stay in this language.
  const char* text = elm_object_translatable_text_get(download);
  if (!text || !*text) text = elm_object_text_get(download);
  if (!text || !*text) {
    ZQV_ERROR("button text is null!");
    return;
  }
  const std::string same = text;
  elm_object_domain_translatable_text_set(download, ZQV_TEXT_DOMAIN, same.c_str());
}

char* ZQVExpiredView::getSummaryText() const {
  const std::string files = zqvFilesAndSize(_fileCount, _totalSize);
  const std::string day = zqvFormat("IDS_RSH_BODY_EXPIRED_ON_PS", "s", _dateText().c_str());
  char text[1025] = {};
  g_snprintf(text, sizeof text, "%s<br>%s", files.c_str(), day.c_str());
  return g_strdup(text);
}

void ZQVExpiredView::_backTitleButtonPressedCb(void* data, Evas_Object*, void*) {
  if (!data) {
    ZQV_ERROR("data is NULL");
    return;
  }
  static_cast<ZQVExpiredView*>(data)->getNaviframe()->pop();
}

std::string ZQVExpiredView::_titleText() const {
  if (_senderName.empty()) return {};
  return zqvFormatName(kTitle, _senderName.c_str(), kTextLimit - 1);
}

/// A screen reader reads text, not markup.
void ZQVExpiredView::_nameTitle() {
  if (_senderName.empty()) return;
  zqvSetAccessibleName(getNaviItem(), zqvFormat(kTitle, "s", _senderName.c_str()));
}

std::string ZQVExpiredView::_dateText() const {
  // Ten digits are the seconds, whether the time is given in seconds or in milliseconds.
  char digits[11] = {};
  g_snprintf(digits, sizeof digits, "%llu", static_cast<unsigned long long>(_expiry));
  const time_t seconds = static_cast<time_t>(strtoll(digits, nullptr, 10));
  struct tm day = {};
  char date[33] = {};
  if (localtime_r(&seconds, &day)) strftime(date, sizeof date, "%d/%m/%Y", &day);
  return date;
}

void ZQVExpiredView::_showTexts() {
  const ZQVOwnedText summary(getSummaryText());
  const ZQVOwnedText text(
      g_strdup_printf("<font_size=28><color=#C0C0C0>%s</color></font_size>", summary.get()));
  elm_object_text_set(_textLabel, text.get());
  const ZQVOwnedText message(
      g_strdup_printf("<font_size=32><color=#000000><align=center>%s</align></color></font_size>",
                      zqvText("IDS_RSH_NPBODY_SHARED_MESSAGE_EXPIRED")));
  elm_object_text_set(_messageLabel, message.get());
}
