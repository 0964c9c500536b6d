#pragma once

#include <Elementary.h>
#include <stdint.h>
#include <unicode/utypes.h>

#include <string>

/// Where the viewer's pictures lie.
#define ZQV_IMAGE_DIR "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/"
/// Where the download application puts files.
#define ZQV_DOWNLOAD_DIR "/opt/usr/media/Downloads"

/// The viewer's theme: the file of its layouts.
std::string zqvThemeFile();

/// Stateless utilities of the whole viewer. Texts that are returned are new and freed with g_free.
class ZQViewerCommon {
 public:
  virtual ~ZQViewerCommon();
  static ZQViewerCommon& getInstance();

  /// The file-type number, 0 to 80, of a file name or (isExtension) of a bare extension.
  int getFileTypeNum(const char* fileInfo, char** matchedExt, int isExtension);

  /// Bytes as a value and its unit "B", "KB" or "MB" (powers of 1024); null without `value`.
  char* zquiCommonConvertFileSizeUnit(uint64_t size, float* value);
  /// `time` in milliseconds since the epoch; null for 0.0, empty when ICU cannot format it.
  char* getDateString(const char* locale, const UChar* skeleton, double time);
  /// `text` is markup: escape a stranger's text first.
  char* makeThemeMarkup(const char* text, const char* textClass, const char* align);
  Evas_Object* createIcon(Evas_Object* parent, const char* path);
  /// A layout of a group of the viewer's theme file.
  Evas_Object* createLayout(Evas_Object* parent, const char* group);
  void dimObject(Evas_Object* obj);

  /// The platform's connection type; 0 is disconnected.
  int zquiCommonCheckNetwork();
  /// Takes the application out of sight; the process lives on.
  void safeExit(Evas_Object* winMain);
  /// Hands a share to the contacts picker, to be sent again.
  void reshare(const char* fileUrl, bool single);

  /// An image that cycles through a null-terminated list of files; the list is borrowed.
  Evas_Object* createGif(Evas_Object* parent, const char** frames);
  void updateGif(Evas_Object* image, const char** frames);

  /// Press, release and move handling; null callbacks take the defaults below.
  void setClickable(Evas_Object* obj, void* data, Evas_Object_Event_Cb upCb,
                    Evas_Object_Event_Cb downCb, Evas_Object_Event_Cb moveCb);
  bool isMoving(Evas_Object* obj);
  static void clickableSelectCb(void* data, Evas* canvas, Evas_Object* obj, void* info);
  static void clickableMouseMove_cb(void* data, Evas* canvas, Evas_Object* obj, void* info);
  static void clickableReleaseCb(void* data, Evas* canvas, Evas_Object* obj, void* info);

 private:
  ZQViewerCommon() = default;
};
