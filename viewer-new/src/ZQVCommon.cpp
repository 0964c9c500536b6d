#include "ZQVCommon.h"

#include <app_common.h>
#include <app_control.h>
#include <efl_assist.h>
#include <net_connection.h>
#include <notification.h>
#include <unicode/udat.h>
#include <unicode/udatpg.h>
#include <unicode/uloc.h>
#include <unicode/ustring.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include "ZQVFrameAnimation.h"
#include "ZQVLog.h"
#include "ZQVOwned.h"
#include "ZQVPressPoint.h"
#include "ZQVText.h"

namespace {

/// A file type's number is its position here; callers read ranges of it, and the first entry that
/// begins with the extension is taken. So the order matters. The last is never compared with one.
constexpr const char* kExtensions[] = {
    "mpeg", "mpg",   "mp4",  "m4v",    "3gp",  "3gpp", "3g2",  "3gpp2", "mkv",  "webm", "ts",
    "avi",  "ram",   "rm",   "rmvb",   "wmv",  "asf",  "divx", "flv",   "tp",   "trp",  "m2ts",
    "mts",  "m2t",   "smi",  "mp3",    "mpga", "m4a",  "wav",  "amr",   "awb",  "3ga",  "wma",
    "qcp",  "evc",   "pva",  "aac",    "pyv",  "dm",   "ogg",  "oga",   "mka",  "mid",  "midi",
    "xmf",  "rtttl", "smf",  "imy",    "rtx",  "ota",  "mxmf", "m3u",   "pls",  "wpl",  "m3u8",
    "fl",   "flac",  "jpeg", "jpg",    "png",  "bmp",  "gif",  "agif",  "webp", "wbmp", "ppt",
    "pptx", "doc",   "docx", "xls",    "xlsx", "hwp",  "gul",  "pdf",   "txt",  "html", "htm",
    "vcf",  "vcs",   "vts",  "invalid"};
constexpr int kUnknownType = 80;
static_assert(G_N_ELEMENTS(kExtensions) == kUnknownType + 1);

constexpr size_t kTextBuffer = 513;

constexpr const char* kContactsPicker = "contacts-tabui-efl";
constexpr const char* kUnableToLaunch =
    "IDS_RSH_TPOP_UNABLE_TO_FIND_APPLICATION_TO_PERFORM_THIS_ACTION";

/// The whole part of a scaled size; what does not fit is the largest number that does.
int wholePart(float value) {
  return value < 2147483648.0f ? static_cast<int>(value) : INT32_MAX;
}

using PatternGenerator = ZQVOwned<UDateTimePatternGenerator, udatpg_close>;
using DateFormat = ZQVOwned<UDateFormat, udat_close>;

/// ICU crashes on a name that is too long for a locale; null is its default locale.
bool isLocale(const char* name) {
  if (!name) return true;
  UErrorCode status = U_ZERO_ERROR;
  char language[ULOC_LANG_CAPACITY] = {};
  uloc_getLanguage(name, language, sizeof language, &status);
  char full[ULOC_FULLNAME_CAPACITY] = {};
  uloc_getName(name, full, sizeof full, &status);
  return U_SUCCESS(status) && status != U_STRING_NOT_TERMINATED_WARNING;
}

/// The best pattern of a locale for a skeleton; its length, 0 for none.
int32_t bestPattern(const char* locale, const UChar* skeleton, UChar* pattern, int32_t capacity) {
  UErrorCode status = U_ZERO_ERROR;
  const PatternGenerator generator(udatpg_open(locale, &status));
  if (U_FAILURE(status)) return 0;
  const int32_t length =
      udatpg_getBestPattern(generator.get(), skeleton, -1, pattern, capacity, &status);
  return U_SUCCESS(status) ? length : 0;
}

/// `text` stays empty when the date cannot be formatted.
void formatDate(const char* locale, const UChar* pattern, int32_t length, double time, char* text,
                int32_t capacity) {
  UErrorCode status = U_ZERO_ERROR;
  const DateFormat format(
      udat_open(UDAT_PATTERN, UDAT_PATTERN, locale, nullptr, -1, pattern, length, &status));
  if (U_FAILURE(status)) return;
  UChar date[255] = {};
  udat_format(format.get(), time, date, G_N_ELEMENTS(date) - 1, nullptr, &status);
  u_strToUTF8(text, capacity, nullptr, date, -1, &status);
  if (U_FAILURE(status)) *text = '\0';
}

/// The toolkit takes colours whose channels do not exceed the alpha only.
void setColor(Evas_Object* obj, int r, int g, int b, int a) {
  evas_object_color_set(obj, std::min(r, a), std::min(g, a), std::min(b, a), a);
}

void darken(Evas_Object* obj) {
  int r, g, b, a;
  evas_object_color_get(obj, &r, &g, &b, &a);
  setColor(obj, r / 2, g / 2, b / 2, a);
}

void brighten(Evas_Object* obj) {
  int r, g, b, a;
  evas_object_color_get(obj, &r, &g, &b, &a);
  setColor(obj, r * 2, g * 2, b * 2, a);
}

void _btnDelCb(void* data, Evas*, Evas_Object* obj, void*) {
  if (!data) {
    ZQV_ERROR("Invalid argument: data is NULL");
    return;
  }
  ZQVPressPoint::forget(obj);
  delete static_cast<ZQVPressPoint*>(data);
}

bool fillReshareRequest(app_control_h request, const char* fileUrl, bool single) {
  const auto add = [request](const char* key, const char* value) {
    return app_control_add_extra_data(request, key, value) == APP_CONTROL_ERROR_NONE;
  };
  return app_control_set_app_id(request, kContactsPicker) == APP_CONTROL_ERROR_NONE &&
         app_control_set_operation(request, APP_CONTROL_OPERATION_DEFAULT) ==
             APP_CONTROL_ERROR_NONE &&
         app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_SINGLE) ==
             APP_CONTROL_ERROR_NONE &&
         add("type", "32") && add("ct_max", "10") && add("ct_app_id", "com.orlant.zelqo") &&
         add("zq_reshare", fileUrl) &&
         add("ct_operation",
             single ? APP_CONTROL_OPERATION_SHARE : APP_CONTROL_OPERATION_MULTI_SHARE);
}

void reshareReplyCb(app_control_h, app_control_h reply, app_control_result_e result, void*) {
  if (result == APP_CONTROL_RESULT_SUCCEEDED) return;
  // The picker tells the user itself what went wrong; its words are fetched and dropped.
  ZQVPlatformText message;
  app_control_get_extra_data(reply, "errorMessage", message.out());
}

}  // namespace

std::string zqvThemeFile() {
  const ZQVPlatformText resources(app_get_resource_path());
  char path[kTextBuffer] = {};
  g_snprintf(path, sizeof path, "%s%s", resources ? resources.get() : "",
             "/edje/remote_share_viewer.edj");
  return path;
}

ZQViewerCommon::~ZQViewerCommon() = default;

ZQViewerCommon& ZQViewerCommon::getInstance() {
  static ZQViewerCommon instance;
  return instance;
}

int ZQViewerCommon::getFileTypeNum(const char* fileInfo, char** matchedExt, int isExtension) {
  if (!fileInfo) {
    // Callers take this for a video, as they always have.
    ZQV_ERROR("fileinfo is NULL");
    return 0;
  }
  const char* dot = isExtension ? nullptr : strrchr(fileInfo, '.');
  if (!isExtension && !dot) return kUnknownType;
  char extension[kTextBuffer] = {};
  g_strlcpy(extension, dot ? dot + 1 : fileInfo, sizeof extension);
  const size_t length = strlen(extension);
  if (length == 0) return kUnknownType;
  for (int number = 0; number < kUnknownType; ++number) {
    if (g_ascii_strncasecmp(extension, kExtensions[number], length) != 0) continue;
    // Only a caller that already holds a text wants another one.
    if (matchedExt && *matchedExt) *matchedExt = g_strdup(kExtensions[number]);
    return number;
  }
  return kUnknownType;
}

char* ZQViewerCommon::zquiCommonConvertFileSizeUnit(uint64_t size, float* value) {
  if (!value) {
    ZQV_ERROR("size is NULL");
    return nullptr;
  }
  const float bytes = static_cast<float>(size);
  const float mega = bytes * 0x1p-20f;
  if (wholePart(mega) > 0) {
    *value = mega;
    return g_strdup("MB");
  }
  const float kilo = bytes * 0x1p-10f;
  if (wholePart(kilo) < 1) {
    *value = bytes;
    return g_strdup("B");
  }
  *value = kilo;
  return g_strdup("KB");
}

char* ZQViewerCommon::getDateString(const char* locale, const UChar* skeleton, double time) {
  if (time == 0.0) return nullptr;
  UErrorCode status = U_ZERO_ERROR;
  const char* environment = getenv("LC_TIME");
  if (isLocale(environment)) uloc_setDefault(environment, &status);
  char name[kTextBuffer] = {};
  if (locale) g_strlcpy(name, locale, sizeof name);
  if (char* codeset = strstr(name, ".UTF-8")) *codeset = '\0';
  const char* where = locale ? name : nullptr;
  UChar pattern[255] = {};
  const int32_t length =
      isLocale(where) ? bestPattern(where, skeleton, pattern, G_N_ELEMENTS(pattern) - 1) : 0;
  char date[255] = {};
  if (length > 0) formatDate(where, pattern, length, time, date, sizeof date);
  return g_strdup(date);
}

char* ZQViewerCommon::makeThemeMarkup(const char* text, const char* textClass, const char* align) {
  ZQVPlatformText font;
  int size = 0;
  int r = 0, g = 0, b = 0, a = 0;
  ea_theme_font_get(textClass, font.out(), &size);
  ea_theme_color_get(textClass, &r, &g, &b, &a, nullptr, nullptr, nullptr, nullptr, nullptr,
                     nullptr, nullptr, nullptr);
  char markup[1025] = {};
  g_snprintf(markup, sizeof markup,
             "<font=%s text_class=%s><font_size=%d><color=#%06x><align=%s>%s</align></color>"
             "</font_size></font>",
             font ? font.get() : "Sans", textClass, size,
             static_cast<unsigned>(r << 16 | g << 8 | b), align, text);
  return g_strdup(markup);
}

Evas_Object* ZQViewerCommon::createIcon(Evas_Object* parent, const char* path) {
  Evas_Object* icon = elm_icon_add(parent);
  // Before the file: after it, a thread would have begun to decode, and the picture would wait.
  elm_image_preload_disabled_set(icon, EINA_TRUE);
  elm_image_file_set(icon, path, nullptr);
  elm_image_aspect_fixed_set(icon, EINA_TRUE);
  evas_object_show(icon);
  return icon;
}

Evas_Object* ZQViewerCommon::createLayout(Evas_Object* parent, const char* group) {
  if (!parent) {
    ZQV_ERROR("!parent");
    return nullptr;
  }
  Evas_Object* layout = elm_layout_add(parent);
  elm_layout_file_set(layout, zqvThemeFile().c_str(), group);
  evas_object_size_hint_weight_set(layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  evas_object_size_hint_align_set(layout, EVAS_HINT_FILL, EVAS_HINT_FILL);
  evas_object_show(layout);
  return layout;
}

void ZQViewerCommon::dimObject(Evas_Object* obj) {
  if (!obj) return;
  int r, g, b, a;
  evas_object_color_get(obj, &r, &g, &b, &a);
  setColor(obj, r, g, b, a / 2);
}

int ZQViewerCommon::zquiCommonCheckNetwork() {
  connection_type_e type = CONNECTION_TYPE_DISCONNECTED;
  connection_h connection = nullptr;
  int result = connection_create(&connection);
  if (result != CONNECTION_ERROR_NONE) {
    ZQV_ERROR("connection_create fail, ret_code = %d", result);
  } else {
    result = connection_get_type(connection, &type);
    if (result != CONNECTION_ERROR_NONE) {
      ZQV_ERROR("connection_get_type fail, ret_code = %d", result);
    }
  }
  connection_destroy(connection);
  return type;
}

void ZQViewerCommon::safeExit(Evas_Object* winMain) {
  if (!winMain) {
    ZQV_ERROR("winMain is NULL");
    return;
  }
  elm_win_lower(winMain);
}

void ZQViewerCommon::reshare(const char* fileUrl, bool single) {
  if (!fileUrl) {
    ZQV_ERROR("fileUrl is NULL");
    return;
  }
  ZQVOwnedAppControl request;
  if (app_control_create(request.out()) != APP_CONTROL_ERROR_NONE) return;
  if (!fillReshareRequest(request.get(), fileUrl, single)) return;
  if (app_control_send_launch_request(request.get(), reshareReplyCb, nullptr) !=
      APP_CONTROL_ERROR_NONE) {
    notification_status_message_post(zqvText(kUnableToLaunch));
  }
}

Evas_Object* ZQViewerCommon::createGif(Evas_Object* parent, const char** frames) {
  return ZQVFrameAnimation::create(parent, frames);
}

void ZQViewerCommon::updateGif(Evas_Object* image, const char** frames) {
  ZQVFrameAnimation::update(image, frames);
}

void ZQViewerCommon::setClickable(Evas_Object* obj, void* data, Evas_Object_Event_Cb upCb,
                                  Evas_Object_Event_Cb downCb, Evas_Object_Event_Cb moveCb) {
  if (!obj) return;
  auto* press = new ZQVPressPoint{};
  ZQVPressPoint::set(obj, press);
  evas_object_event_callback_add(obj, EVAS_CALLBACK_MOUSE_DOWN, downCb ? downCb : clickableSelectCb,
                                 data);
  evas_object_event_callback_add(obj, EVAS_CALLBACK_MOUSE_UP, upCb ? upCb : clickableReleaseCb,
                                 data);
  evas_object_event_callback_add(obj, EVAS_CALLBACK_MOUSE_MOVE,
                                 moveCb ? moveCb : clickableMouseMove_cb, data);
  evas_object_event_callback_add(obj, EVAS_CALLBACK_DEL, _btnDelCb, press);
}

bool ZQViewerCommon::isMoving(Evas_Object* obj) {
  return ZQVPressPoint::isMoving(obj);
}

void ZQViewerCommon::clickableSelectCb(void*, Evas*, Evas_Object* obj, void* info) {
  darken(obj);
  if (!info) {
    ZQV_ERROR("Invalid argument: event info is NULL");
    return;
  }
  if (ZQVPressPoint* press = ZQVPressPoint::of(obj)) {
    const auto* event = static_cast<Evas_Event_Mouse_Down*>(info);
    *press = {event->canvas.x, event->canvas.y};
  }
  ZQVPressPoint::setMoving(obj, false);
}

void ZQViewerCommon::clickableMouseMove_cb(void*, Evas*, Evas_Object* obj, void* info) {
  if (!info) {
    ZQV_ERROR("Invalid argument: event info is NULL");
    return;
  }
  const auto* event = static_cast<Evas_Event_Mouse_Move*>(info);
  const ZQVPressPoint* press = ZQVPressPoint::of(obj);
  // A touch screen reports no moves without a finger on it; a mouse does.
  if (!press || !event->buttons) return;
  if (!press->isFurtherThan(ZQVPressPoint::kTapDistance, event->cur.canvas)) return;
  ZQVPressPoint::setMoving(obj, true);
  brighten(obj);
}

/// A drag has been brightened by its move already and is brightened here once more: so it has
/// always looked, the object flashes when the finger lets go.
void ZQViewerCommon::clickableReleaseCb(void*, Evas*, Evas_Object* obj, void*) {
  brighten(obj);
  ZQVPressPoint::setMoving(obj, false);
}
