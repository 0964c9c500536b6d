#pragma once

/// The file icons' folder.
#define ZQV_FILE_ICON_DIR "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/fileicon/"
/// What stands until a picture has been downloaded.
#define ZQV_SMALL_IMG_ICON ZQV_FILE_ICON_DIR "80x80/zq_file_ic_img.png"
#define ZQV_LARGE_IMG_ICON ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_img.png"
#define ZQV_LARGE_UNKNOWN_ICON ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_unknown.png"

/// The icon that stands for a file without a picture. Paths are new texts, freed with g_free.
class ZQVIcons {
 public:
  /// `mimeType` must not be null. Audio has no icon of its own here.
  static char* getIconPath(const char* mimeType, bool small);
  /// The same with the music icon for audio; null, with an error line, for a null type.
  static char* _getOthersIconPath(const char* mimeType, bool small);

  /// The kind of file as an English word, which is also its message id. Null counts as unknown.
  static const char* getKindName(const char* mimeType);
};
