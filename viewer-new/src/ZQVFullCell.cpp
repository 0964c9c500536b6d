#include "ZQVFullCell.h"

#include <glib.h>

#include <cstring>

#include "ZQVCellParts.h"
#include "ZQVCommon.h"
#include "ZQVIcons.h"
#include "ZQVItemGrid.h"
#include "ZQVLog.h"
#include "ZQVMarkup.h"
#include "ZQVOwned.h"
#include "ZQVPictureButton.h"
#include "ZQVPictureGate.h"
#include "ZQVScreenPicture.h"
#include "ZQVThumbItem.h"

namespace {

constexpr const char* kShadow = ZQV_IMAGE_DIR "zq_file_full_ic_shadow.png";
constexpr size_t kTextBuffer = 1025;
/// Leaves room for the tags in the label's buffer.
constexpr size_t kLongestName = 960;

bool hasPicture(const char* mimeType) {
  return zqvContains(mimeType, "video/") || zqvContains(mimeType, "image/") ||
         zqvContains(mimeType, "/octet-stream");
}

bool isDimmed(const ZQViewerThumbnailItem* item, Evas_Object* grid) {
  if (ZQVItemGrid::viewTypeOf(grid) != ZQV_VIEW_FULL_SENDER) return false;
  return !item->thumbPath || !ecore_file_exists(item->thumbPath) ||
         strcmp(item->thumbPath, ZQV_LARGE_IMG_ICON) == 0;
}

/// The picture to show; a file that may not be shown counts as not there, and null stays null.
ZQVOwnedText pictureOf(const ZQViewerThumbnailItem* item) {
  const char* path = ZQVFullCell::pathOf(*item);
  if (!path) return nullptr;
  if (ZQVPictureGate::passes(path, ZQVPictureGate::FullView)) return ZQVOwnedText(g_strdup(path));
  return ZQVOwnedText(item->mimeType ? ZQVIcons::_getOthersIconPath(item->mimeType, false)
                                     : g_strdup(ZQV_LARGE_UNKNOWN_ICON));
}

Evas_Object* addText(Evas_Object* layout, const char* part, const char* markup) {
  Evas_Object* label = zqvCreateLabel(layout, markup);
  elm_object_part_content_set(layout, part, label);
  return label;
}

Evas_Object* addName(const ZQViewerThumbnailItem* item, Evas_Object* layout) {
  char text[kTextBuffer] = {};
  g_snprintf(text, sizeof text, "<align=center><font_size=32>%s</font_size></align>",
             zqvEscapeWithin(item->fileName, kLongestName).c_str());
  Evas_Object* label = addText(layout, "filename", text);
  elm_label_line_wrap_set(label, ELM_WRAP_MIXED);
  return label;
}

Evas_Object* addSize(const ZQViewerThumbnailItem* item, Evas_Object* layout) {
  float value = 0;
  const ZQVOwnedText unit(
      ZQViewerCommon::getInstance().zquiCommonConvertFileSizeUnit(item->fileSize, &value));
  char text[kTextBuffer] = {};
  g_snprintf(text, sizeof text, "<align=center><font_size=32>%0.1f%s</font_size></align>",
             static_cast<double>(value), unit.get());
  return addText(layout, "filesize", text);
}

void addFile(const ZQViewerThumbnailItem* item, Evas_Object* grid, Evas_Object* layout) {
  auto& common = ZQViewerCommon::getInstance();
  Evas_Object* icon = common.createIcon(grid, pictureOf(item).get());
  elm_object_part_content_set(layout, "logo", icon);
  common.setClickable(icon, grid, ZQVPictureButton::_mouseUpCb, ZQVPictureButton::_mouseDownCb,
                      nullptr);
  elm_object_part_content_set(layout, "logo_bg", common.createIcon(grid, kShadow));
  // Name and size stand on a card of the theme's own, legible in light and dark.
  elm_layout_signal_emit(layout, "elm,state,card,show", "elm");
  Evas_Object* name = addName(item, layout);
  Evas_Object* size = addSize(item, layout);
  if (!isDimmed(item, grid)) return;
  for (Evas_Object* part : {icon, name, size}) common.dimObject(part);
}

/// The page that the pager opens with comes with its picture; turning a page waits for none.
ZQVScreenPicture::First firstOf(const ZQViewerThumbnailItem* item, Evas_Object* pager) {
  return evas_object_data_get(pager, ZQVFullCell::kOpening) == item
             ? ZQVScreenPicture::First::AtOnce
             : ZQVScreenPicture::First::WhenDecoded;
}

Evas_Object* addPicture(const ZQViewerThumbnailItem* item, Evas_Object* grid, Evas_Object* layout) {
  auto& common = ZQViewerCommon::getInstance();
  const ZQVOwnedText path = pictureOf(item);
  Evas_Object* picture = common.createIcon(grid, path.get());
  const bool isDefault = g_strcmp0(path.get(), ZQV_LARGE_IMG_ICON) == 0 ||
                         g_strcmp0(path.get(), ZQV_LARGE_UNKNOWN_ICON) == 0;
  elm_object_part_content_set(layout, isDefault ? "default_thumbnail" : "thumbnail", picture);
  elm_image_prescale_set(picture, ZQVScreenPicture::kFirstSize);
  if (elm_image_animated_available_get(picture)) {
    elm_image_animated_set(picture, EINA_TRUE);
    elm_image_animated_play_set(picture, EINA_TRUE);
  } else if (path && !isDefault) {
    ZQVScreenPicture::follow(picture, path.get(), grid, firstOf(item, grid));
  }
  if (isDimmed(item, grid)) common.dimObject(picture);
  return picture;
}

void addPlayButton(Evas_Object* grid, Evas_Object* layout) {
  zqvAddColouredIcon(grid, layout, "playicon",
                     ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_video_play.png", "AO015");
  Evas_Object* background =
      zqvAddColouredIcon(grid, layout, "playiconBG", ZQVPictureButton::kVideoIcon, "W025");
  zqvAddColouredIcon(grid, layout, "playiconEF",
                     ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_video_ef.png", "W026");
  evas_object_data_set(background, "width", GINT_TO_POINTER(0));
  evas_object_data_set(background, "height", GINT_TO_POINTER(0));
  ZQViewerCommon::getInstance().setClickable(background, grid, ZQVPictureButton::_mouseUpCb,
                                             ZQVPictureButton::_mouseDownCb,
                                             ZQVPictureButton::_mouseMoveCb);
}

}  // namespace

const char* ZQVFullCell::pathOf(const ZQViewerThumbnailItem& item) {
  return item.largePath ? item.largePath : item.thumbPath;
}

Evas_Object* ZQVFullCell::__getFullViewContent(const ZQViewerThumbnailItem* item, Evas_Object* grid,
                                               const char* part) {
  if (!item || !grid || !part) {
    ZQV_ERROR("!data || !obj || !part");
    return nullptr;
  }
  if (strcmp(part, "elm.swallow.icon") != 0) return nullptr;
  auto& common = ZQViewerCommon::getInstance();
  const bool video = zqvContains(item->mimeType, "video/");
  Evas_Object* layout = common.createLayout(grid, video ? "fullgriditem_video" : "fullgriditem");
  if (!hasPicture(item->mimeType)) {
    addFile(item, grid, layout);
    return layout;
  }
  Evas_Object* picture = addPicture(item, grid, layout);
  if (video) {
    addPlayButton(grid, layout);
  } else {
    common.setClickable(picture, grid, ZQVPictureButton::_mouseUpCb, ZQVPictureButton::_mouseDownCb,
                        nullptr);
  }
  return layout;
}
