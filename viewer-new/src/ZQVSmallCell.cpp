#include "ZQVSmallCell.h"

#include <algorithm>
#include <cstring>

#include "ZQVCellParts.h"
#include "ZQVCommon.h"
#include "ZQVFilePages.h"
#include "ZQVFrames.h"
#include "ZQVIcons.h"
#include "ZQVItemGrid.h"
#include "ZQVLog.h"
#include "ZQVMarkup.h"
#include "ZQVOwned.h"
#include "ZQVPictureGate.h"
#include "ZQVThumbItem.h"

namespace {

/// Leaves room for the tags in the markup's buffer.
constexpr size_t kLongestName = 768;
constexpr int kPrescale = 32;

Evas_Object* createCheck(const ZQViewerThumbnailItem* item, Evas_Object* grid) {
  Evas_Object* check = elm_check_add(grid);
  elm_check_state_set(check, item->checked);
  // The check only shows the state: taps and keys are for the cell.
  elm_object_focus_allow_set(check, EINA_FALSE);
  evas_object_repeat_events_set(check, EINA_TRUE);
  evas_object_propagate_events_set(check, EINA_FALSE);
  // Registered without a function, which the toolkit ignores: a change is nobody's business here.
  evas_object_smart_callback_add(check, "changed", nullptr, item);
  evas_object_show(check);
  return check;
}

/// The picture to show; a file that may not be shown counts as not there.
std::string pictureOf(const ZQViewerThumbnailItem* item) {
  if (ZQVPictureGate::passes(item->thumbPath, ZQVPictureGate::Thumbnail)) return item->thumbPath;
  if (!item->mimeType) return ZQV_SMALL_IMG_ICON;
  const ZQVOwnedText icon(ZQVIcons::_getOthersIconPath(item->mimeType, true));
  return icon.get();
}

void addName(const ZQViewerThumbnailItem* item, Evas_Object* layout, bool dimmed) {
  auto& common = ZQViewerCommon::getInstance();
  const std::string name = zqvEscapeWithin(item->fileName, kLongestName);
  const ZQVOwnedText markup(common.makeThemeMarkup(name.c_str(), "T034L2", "center"));
  Evas_Object* label = zqvCreateLabel(layout, markup.get());
  if (dimmed) common.dimObject(label);
  elm_object_part_content_set(layout, "filename", label);
}

bool isScrolled(Evas_Object* grid) {
  int y = 0;
  elm_scroller_region_get(grid, nullptr, &y, nullptr, nullptr);
  return y > 0;
}

/// A picture that is decoded at a fraction of its size gets as many pixels as the cell has.
void setPrescale(Evas_Object* icon, Evas_Object* grid, bool isReducible) {
  elm_image_prescale_set(icon, kPrescale);
  if (!isReducible) return;
  int width = 0;
  int height = 0;
  elm_gengrid_item_size_get(grid, &width, &height);
  elm_image_prescale_set(icon, std::max({width, height, kPrescale}));
}

/// A prescale that is set last ends the preloading: a page is there with all its thumbnails. When
/// it is scrolled nothing waits for a picture, nor ever for a photo that has no thumbnail.
void setUpDecoding(Evas_Object* icon, Evas_Object* grid, const char* path) {
  const ZQVPictureGate::Decoding decoding = ZQVPictureGate::decodingOf(path);
  const bool later = isScrolled(grid) || decoding.isSlow;
  if (later) setPrescale(icon, grid, decoding.isReducible);
  if (later && decoding.isReducible) ZQVFilePages::dropWhenDecoded(elm_image_object_get(icon));
  elm_image_preload_disabled_set(icon, EINA_FALSE);
  if (!later) setPrescale(icon, grid, decoding.isReducible);
}

void addPicture(const ZQViewerThumbnailItem* item, Evas_Object* grid, Evas_Object* layout) {
  const bool sender = ZQVItemGrid::viewTypeOf(grid) == ZQV_VIEW_SENDER;
  const std::string path = pictureOf(item);
  const bool isDefault = path == ZQV_SMALL_IMG_ICON;
  const bool dimmed = sender && (isDefault || path != (item->thumbPath ? item->thumbPath : ""));

  Evas_Object* icon = ZQViewerCommon::getInstance().createIcon(grid, path.c_str());
  elm_image_fill_outside_set(icon, EINA_TRUE);
  setUpDecoding(icon, grid, path.c_str());
  if (dimmed) ZQViewerCommon::getInstance().dimObject(icon);

  if (item->thumbUrl || !item->fileName) {
    elm_object_part_content_set(layout, !sender && isDefault ? "default_thumbnail" : "thumbnail",
                                icon);
    return;
  }
  elm_object_part_content_set(layout, "logo", icon);
  addName(item, layout, dimmed);
}

void addVideoMarks(Evas_Object* grid, Evas_Object* layout) {
  zqvAddColouredIcon(grid, layout, "playicon", ZQV_FILE_ICON_DIR "80x80/zq_file_ic_video_play.png",
                     "AO015");
  zqvAddColouredIcon(grid, layout, "playiconBG", ZQV_FILE_ICON_DIR "80x80/zq_file_ic_video_bg.png",
                     "W025");
  zqvAddColouredIcon(grid, layout, "playiconEF", ZQV_FILE_ICON_DIR "80x80/zq_file_ic_video_ef.png",
                     "W026");
}

void addDownloadStatus(const ZQViewerThumbnailItem* item, Evas_Object* grid, Evas_Object* layout) {
  const char** frames = nullptr;
  if (item->downloadStatus == ZQV_DOWNLOADED) frames = zqvDownloadedSmallFrames;
  if (item->downloadStatus == ZQV_DOWNLOADING) frames = zqvDownloadingSmallFrames;
  if (!frames) return;
  Evas_Object* status = ZQViewerCommon::getInstance().createGif(grid, frames);
  elm_object_part_content_set(layout, "downstatus", status);
}

}  // namespace

Evas_Object* ZQVSmallCell::__getContent(const ZQViewerThumbnailItem* item, Evas_Object* grid,
                                        const char* part) {
  if (!item || !grid || !part) {
    ZQV_ERROR("!data || !obj || !part");
    return nullptr;
  }
  const int viewType = ZQVItemGrid::viewTypeOf(grid);
  if (strcmp(part, "elm.swallow.end") == 0) {
    return viewType == ZQV_VIEW_SELECT ? createCheck(item, grid) : nullptr;
  }
  if (strcmp(part, "elm.swallow.icon") != 0) return nullptr;
  Evas_Object* layout = ZQViewerCommon::getInstance().createLayout(grid, "griditem");
  addPicture(item, grid, layout);
  if (zqvContains(item->mimeType, "video/")) addVideoMarks(grid, layout);
  if (viewType == ZQV_VIEW_RECEIVER) addDownloadStatus(item, grid, layout);
  return layout;
}
