#include "ZQVAccess.h"

#include <glib.h>

#include "ZQVCommon.h"
#include "ZQVIcons.h"
#include "ZQVOwned.h"
#include "ZQVText.h"
#include "ZQVThumbItem.h"

namespace {

/// The bus that carries the names takes valid UTF-8 only.
std::string validText(const char* text) {
  ZQVOwnedText valid(g_utf8_make_valid(text, -1));
  return valid.get();
}

std::string sizeText(uint32_t size) {
  float value = 0;
  ZQVOwnedText unit(ZQViewerCommon::getInstance().zquiCommonConvertFileSizeUnit(size, &value));
  ZQVOwnedText text(g_strdup_printf("%.1f%s", value, unit.get()));
  return text.get();
}

const char* stateText(const ZQViewerThumbnailItem& item) {
  if (item.filePath) return item.noThumbnail ? "missing" : "on this phone";
  switch (item.downloadStatus) {
    case ZQV_REQUESTED:
      return "requested";
    case ZQV_DOWNLOADING:
      return "downloading";
    case ZQV_DOWNLOADED:
      return "downloaded";
    default:
      return "not downloaded";
  }
}

}  // namespace

void zqvSetAccessibleName(Eo* object, const std::string& name) {
  if (object) efl_access_object_i18n_name_set(object, validText(name.c_str()).c_str());
}

std::string zqvCellName(const ZQViewerThumbnailItem& item) {
  std::string name = validText(item.fileName ? item.fileName : "");
  name.append(", ").append(sizeText(item.fileSize));
  name.append(", ").append(zqvText(ZQVIcons::getKindName(item.mimeType)));
  name.append(", ").append(zqvText(stateText(item)));
  return name;
}
