#include <efl_assist.h>

#include <fstream>

#include "PageTest.h"
#include "ZQVCommon.h"
#include "ZQVFullCell.h"
#include "ZQVIcons.h"
#include "ZQVSmallCell.h"

namespace {

constexpr int kPhotoSide = 1000;

/// Of the file's pages, those that are in this process's memory; -1 when the file is not mapped.
int residentKilobytes(const std::string& path) {
  std::ifstream maps("/proc/self/smaps");
  int sum = -1;
  bool inFile = false;
  for (std::string line; std::getline(maps, line);) {
    int kilobytes = 0;
    // What is said of a mapping begins with a capital letter, unlike its address.
    if (!isupper(line[0])) inFile = line.find(path) != std::string::npos;
    if (inFile && sscanf(line.c_str(), "Rss: %d", &kilobytes) == 1) {
      sum = std::max(sum, 0) + kilobytes;
    }
  }
  return sum;
}

void setTrue(void* flag, Evas*, Evas_Object*, void*) {
  *static_cast<bool*>(flag) = true;
}

class GridItem : public PageTest {
 protected:
  void SetUp() override {
    PageTest::SetUp();
    photo = picture("photo.png");
    grid = elm_gengrid_add(window);
  }
  void TearDown() override {
    if (cell) evas_object_del(cell);
    evas_object_del(grid);
    PageTest::TearDown();
  }

  ZQViewerThumbnailItem& file(const char* name, const char* type, const char* thumb,
                              const char* thumbUrl) {
    ZQViewerThumbnailItem& item = items.add(name, 1536);
    replaceText(&item.mimeType, type);
    replaceText(&item.thumbPath, thumb);
    replaceText(&item.largePath, thumb);
    replaceText(&item.thumbUrl, thumbUrl);
    return item;
  }
  void setViewType(int type) {
    evas_object_data_set(grid, "ViewType", reinterpret_cast<void*>(static_cast<intptr_t>(type)));
  }
  Evas_Object* contentOf(ZQViewerThumbnailItem& item, const char* part, int viewType) {
    setViewType(viewType);
    if (cell) evas_object_del(cell);
    cell = item.getItemClass()->func.content_get(&item, grid, part);
    return cell;
  }
  void build(ZQViewerThumbnailItem& item, int viewType) {
    contentOf(item, "elm.swallow.icon", viewType);
  }
  Evas_Object* part(const char* name) const { return elm_object_part_content_get(cell, name); }
  std::string fileIn(const char* name) const {
    Evas_Object* icon = part(name);
    const char* path = nullptr;
    if (!icon) return "(no content)";
    elm_image_file_get(icon, &path, nullptr);
    return path ? path : "(no file)";
  }
  static int alphaOf(Evas_Object* object) {
    int alpha = 0;
    evas_object_color_get(object, nullptr, nullptr, nullptr, &alpha);
    return alpha;
  }
  std::string colourOf(const char* name) const {
    const char* code = static_cast<char*>(evas_object_data_get(part(name), "test_color"));
    return code ? code : "";
  }

  std::string photo;
  Evas_Object* grid = nullptr;
  Evas_Object* cell = nullptr;
};

TEST_F(GridItem, HasOneItemClassForAllFiles) {
  ZQViewerThumbnailItem& a = items.add("a", 1);
  ZQViewerThumbnailItem& b = items.add("b", 1);
  EXPECT_EQ(a.getItemClass(), b.getItemClass());
  EXPECT_STREQ(a.getItemClass()->item_style, "default");
  EXPECT_EQ(a.getItemClass()->func.text_get, nullptr);
  EXPECT_EQ(a.getItemClass()->func.state_get, nullptr);
  EXPECT_EQ(a.getItemClass()->func.del, nullptr);
}

TEST_F(GridItem, NeedsItemGridAndPart) {
  ZQViewerThumbnailItem& item = items.add("a", 1);
  EXPECT_EQ(ZQVSmallCell::__getContent(nullptr, grid, "x"), nullptr);
  EXPECT_EQ(ZQVSmallCell::__getContent(&item, nullptr, "x"), nullptr);
  EXPECT_EQ(ZQVSmallCell::__getContent(&item, grid, nullptr), nullptr);
  EXPECT_EQ(ZQVFullCell::__getFullViewContent(nullptr, grid, "x"), nullptr);
  EXPECT_EQ(errors(), Errors(4, "!data || !obj || !part"));
}

TEST_F(GridItem, HasACheckInTheSelectGridOnly) {
  ZQViewerThumbnailItem& item = file("a.pdf", "application/pdf", photo.c_str(), nullptr);
  item.checked = true;
  ASSERT_NE(contentOf(item, "elm.swallow.end", ZQV_VIEW_SELECT), nullptr);
  EXPECT_TRUE(elm_check_state_get(cell));
  EXPECT_TRUE(evas_object_visible_get(cell));
  for (int other : {ZQV_VIEW_NONE, ZQV_VIEW_RECEIVER, ZQV_VIEW_SENDER, ZQV_VIEW_FULL_RECEIVER}) {
    EXPECT_EQ(contentOf(item, "elm.swallow.end", other), nullptr);
  }
  EXPECT_EQ(contentOf(item, "elm.swallow.other", ZQV_VIEW_SELECT), nullptr);
}

TEST_F(GridItem, ShowsAThumbnailThatHasArrived) {
  build(file("a.png", "image/png", photo.c_str(), "url"), ZQV_VIEW_RECEIVER);
  EXPECT_EQ(fileIn("thumbnail"), photo);
  EXPECT_EQ(part("default_thumbnail"), nullptr);
  EXPECT_EQ(part("logo"), nullptr);
  EXPECT_EQ(part("filename"), nullptr);
  EXPECT_EQ(part("playicon"), nullptr);
  EXPECT_EQ(part("downstatus"), nullptr);
}

TEST_F(GridItem, HasAJpegDecodedWithAsManyPixelsAsTheCell) {
  elm_gengrid_item_size_set(grid, 180, 160);
  const std::string jpeg = picture("small.jpg", 320);
  build(file("small.jpg", "image/jpeg", jpeg.c_str(), "url"), ZQV_VIEW_RECEIVER);
  EXPECT_EQ(elm_image_prescale_get(part("thumbnail")), 180);
  build(file("a.png", "image/png", photo.c_str(), "url"), ZQV_VIEW_RECEIVER);
  EXPECT_EQ(elm_image_prescale_get(part("thumbnail")), 32);
}

TEST_F(GridItem, WaitsForNoPhotoThatHasNoThumbnail) {
  const std::string large = picture("large.jpg", kPhotoSide);
  build(file("large.jpg", "image/jpeg", large.c_str(), "url"), ZQV_VIEW_SENDER);
  bool decoded = false;
  evas_object_event_callback_add(elm_image_object_get(part("thumbnail")),
                                 EVAS_CALLBACK_IMAGE_PRELOADED, setTrue, &decoded);
  EXPECT_TRUE(waitUntil([&decoded] { return decoded; }));
}

TEST_F(GridItem, KeepsNoFileInMemoryWhosePictureIsDecoded) {
  const std::string large = picture("kept.jpg", kPhotoSide);
  build(file("kept.jpg", "image/jpeg", large.c_str(), "url"), ZQV_VIEW_SENDER);
  ASSERT_GT(residentKilobytes(large), 0);
  EXPECT_TRUE(waitUntil([&large] { return residentKilobytes(large) == 0; }));
}

TEST_F(GridItem, ShowsTheImageIconUntilTheThumbnailArrives) {
  build(file("a.png", "image/png", ZQV_SMALL_IMG_ICON, "url"), ZQV_VIEW_SELECT);
  EXPECT_EQ(fileIn("default_thumbnail"), ZQV_SMALL_IMG_ICON);
  build(file("a.png", "image/png", ZQV_SMALL_IMG_ICON, "url"), ZQV_VIEW_SENDER);
  EXPECT_EQ(fileIn("thumbnail"), ZQV_SMALL_IMG_ICON);
}

TEST_F(GridItem, ShowsIconAndNameOfAFileWithoutAThumbnail) {
  build(file("a&b.pdf", "application/pdf", photo.c_str(), nullptr), ZQV_VIEW_RECEIVER);
  EXPECT_EQ(fileIn("logo"), photo);
  EXPECT_EQ(textOf(part("filename")),
            "<font=Sans text_class=T034L2><font_size=34><color=#003456><align=center>a&amp;b.pdf"
            "</align></color></font_size></font>");
  EXPECT_TRUE(elm_label_ellipsis_get(part("filename")));
  EXPECT_EQ(elm_label_line_wrap_get(part("filename")), ELM_WRAP_NONE);
}

TEST_F(GridItem, KeepsTheMarkupOfAVeryLongNameWhole) {
  build(file(std::string(3000, '<').c_str(), "application/pdf", photo.c_str(), nullptr),
        ZQV_VIEW_RECEIVER);
  const std::string markup = textOf(part("filename"));
  EXPECT_LT(markup.size(), 1024u);
  EXPECT_NE(markup.find("&lt;</align></color></font_size></font>"), std::string::npos);
}

TEST_F(GridItem, ShowsNoNameWhereThereIsNone) {
  ZQViewerThumbnailItem& item = file("a", "application/pdf", photo.c_str(), nullptr);
  replaceText(&item.fileName, nullptr);
  build(item, ZQV_VIEW_RECEIVER);
  EXPECT_EQ(fileIn("thumbnail"), photo);
  EXPECT_EQ(part("filename"), nullptr);
}

TEST_F(GridItem, MarksAFilm) {
  build(file("a.mp4", "video/mp4", photo.c_str(), "url"), ZQV_VIEW_SENDER);
  EXPECT_EQ(fileIn("playicon"), ZQV_FILE_ICON_DIR "80x80/zq_file_ic_video_play.png");
  EXPECT_EQ(fileIn("playiconBG"), ZQV_FILE_ICON_DIR "80x80/zq_file_ic_video_bg.png");
  EXPECT_EQ(fileIn("playiconEF"), ZQV_FILE_ICON_DIR "80x80/zq_file_ic_video_ef.png");
  EXPECT_EQ(colourOf("playicon"), "AO015");
  EXPECT_EQ(colourOf("playiconBG"), "W025");
  EXPECT_EQ(colourOf("playiconEF"), "W026");
}

TEST_F(GridItem, ShowsTheStateOfItsDownloadInTheReceiverGridOnly) {
  ZQViewerThumbnailItem& item = file("a.png", "image/png", photo.c_str(), "url");
  item.downloadStatus = ZQV_DOWNLOADED;
  build(item, ZQV_VIEW_RECEIVER);
  EXPECT_EQ(fileIn("downstatus"), ZQV_IMAGE_DIR "zq_ic_downloaded_02.png");
  build(item, ZQV_VIEW_SELECT);
  EXPECT_EQ(part("downstatus"), nullptr);
  for (int status : {ZQV_NOT_DOWNLOADED, ZQV_REQUESTED}) {
    item.downloadStatus = status;
    build(item, ZQV_VIEW_RECEIVER);
    EXPECT_EQ(part("downstatus"), nullptr);
  }
}

TEST_F(GridItem, AnimatesARunningDownload) {
  ZQViewerThumbnailItem& item = file("a.png", "image/png", photo.c_str(), "url");
  item.downloadStatus = ZQV_DOWNLOADING;
  build(item, ZQV_VIEW_RECEIVER);
  const std::string frame = ZQV_IMAGE_DIR "zq_ic_download_progress/31/zq_ic_download_process0";
  for (int step = 0; step <= 7; ++step) {
    EXPECT_EQ(fileIn("downstatus"), frame + std::to_string(step % 7) + ".png");
    FakeClock::advance(0.3);
  }
  evas_object_del(cell);
  cell = nullptr;
  EXPECT_EQ(FakeClock::running(), 0);
}

TEST_F(GridItem, IsASimpleSmallCellInAGridOfNoKind) {
  ZQViewerThumbnailItem& item = file("a.png", "image/png", photo.c_str(), "url");
  item.downloadStatus = ZQV_DOWNLOADED;
  build(item, ZQV_VIEW_NONE);
  EXPECT_EQ(fileIn("thumbnail"), photo);
  EXPECT_EQ(part("downstatus"), nullptr);
}

TEST_F(GridItem, IsDimmedInTheSenderGridWhenItsFileIsMissing) {
  build(file("a.png", "image/png", "/no/such/file.png", "url"), ZQV_VIEW_SENDER);
  EXPECT_EQ(alphaOf(part("thumbnail")), 127);
  build(file("a.png", "image/png", photo.c_str(), "url"), ZQV_VIEW_SENDER);
  EXPECT_EQ(alphaOf(part("thumbnail")), 255);
  build(file("a.png", "image/png", "/no/such/file.png", "url"), ZQV_VIEW_RECEIVER);
  EXPECT_EQ(alphaOf(part("default_thumbnail")), 255);
}

TEST_F(GridItem, DimsIconAndNameOfAMissingFileWithoutAThumbnail) {
  build(file("a.pdf", "application/pdf", "/no/such/file.png", nullptr), ZQV_VIEW_SENDER);
  EXPECT_EQ(alphaOf(part("logo")), 127);
  EXPECT_EQ(alphaOf(part("filename")), 127);
}

TEST_F(GridItem, ShowsTheIconOfTheKindInPlaceOfAPictureThatMayNotBeShown) {
  const std::string bad = photo + ".bad.png";
  std::ofstream(bad) << "no picture at all";
  build(file("a.png", "image/png", bad.c_str(), "url"), ZQV_VIEW_RECEIVER);
  EXPECT_EQ(fileIn("default_thumbnail"), ZQV_SMALL_IMG_ICON);
  build(file("a.pdf", "application/pdf", bad.c_str(), nullptr), ZQV_VIEW_RECEIVER);
  EXPECT_EQ(fileIn("logo"), ZQV_FILE_ICON_DIR "80x80/zq_file_ic_pdf.png");
}

TEST_F(GridItem, NeedsASelectGridForACheck) {
  items.add("a", 1).setCheckStatus(true);
  EXPECT_EQ(errors(), Errors({"It is not select mode"}));
  EXPECT_FALSE(items[0].checked);
}

TEST_F(GridItem, NeedsACheckThatIsShown) {
  setViewType(ZQV_VIEW_SELECT);
  ZQViewerThumbnailItem& item = items.add("a", 1);
  item.gridItems[ZQV_VIEW_SELECT] =
      elm_gengrid_item_append(grid, item.getItemClass(), &item, nullptr, nullptr);
  item.setCheckStatus(true);
  EXPECT_EQ(errors(), Errors({"Fail to get check"}));
  EXPECT_FALSE(item.checked);
}

class FullViewCell : public GridItem {
 protected:
  ZQViewerThumbnailItem& large(const char* type, const char* path) {
    ZQViewerThumbnailItem& item = file("a&b.pdf", type, photo.c_str(), nullptr);
    replaceText(&item.largePath, path);
    return item;
  }
};

TEST_F(FullViewCell, ShowsIconShadowNameAndSizeOfAFileWithoutAPicture) {
  build(large("application/pdf", photo.c_str()), ZQV_VIEW_FULL_RECEIVER);
  EXPECT_EQ(fileIn("logo"), photo);
  EXPECT_EQ(fileIn("logo_bg"), ZQV_IMAGE_DIR "zq_file_full_ic_shadow.png");
  EXPECT_EQ(textOf(part("filename")),
            "<align=center><font_size=32>a&amp;b.pdf</font_size></align>");
  EXPECT_EQ(textOf(part("filesize")), "<align=center><font_size=32>1.5KB</font_size></align>");
  EXPECT_EQ(elm_label_line_wrap_get(part("filename")), ELM_WRAP_MIXED);
  EXPECT_EQ(elm_label_line_wrap_get(part("filesize")), ELM_WRAP_NONE);
  EXPECT_EQ(part("thumbnail"), nullptr);
}

TEST_F(FullViewCell, ShowsThePictureOfAnImageAFilmOrAnUnknownFile) {
  for (const char* type : {"image/png", "video/mp4", "application/octet-stream"}) {
    build(large(type, photo.c_str()), ZQV_VIEW_FULL_RECEIVER);
    EXPECT_EQ(fileIn("thumbnail"), photo) << type;
    EXPECT_EQ(part("logo"), nullptr);
  }
}

TEST_F(FullViewCell, ShowsTheSmallPictureWithoutALargeOne) {
  build(large("image/png", nullptr), ZQV_VIEW_FULL_RECEIVER);
  EXPECT_EQ(fileIn("thumbnail"), photo);
}

TEST_F(FullViewCell, IsEmptyWithoutAnyPicture) {
  ZQViewerThumbnailItem& item = large("image/png", nullptr);
  replaceText(&item.thumbPath, nullptr);
  build(item, ZQV_VIEW_FULL_RECEIVER);
  EXPECT_EQ(fileIn("thumbnail"), "(no file)");
}

TEST_F(FullViewCell, PutsTheDefaultIconsInTheirOwnPlace) {
  build(large("image/png", ZQV_LARGE_IMG_ICON), ZQV_VIEW_FULL_RECEIVER);
  EXPECT_EQ(fileIn("default_thumbnail"), ZQV_LARGE_IMG_ICON);
  build(large("application/octet-stream", ZQV_LARGE_UNKNOWN_ICON), ZQV_VIEW_FULL_RECEIVER);
  EXPECT_EQ(fileIn("default_thumbnail"), ZQV_LARGE_UNKNOWN_ICON);
  EXPECT_EQ(part("thumbnail"), nullptr);
}

TEST_F(FullViewCell, HasAPlayMarkThatIsAButtonOnAFilm) {
  build(large("video/mp4", photo.c_str()), ZQV_VIEW_FULL_RECEIVER);
  EXPECT_EQ(fileIn("playiconBG"), ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_video_bg.png");
  EXPECT_EQ(colourOf("playiconEF"), "W026");
  EXPECT_NE(evas_object_data_get(part("playiconBG"), "point_down"), nullptr);
  EXPECT_EQ(evas_object_data_get(part("thumbnail"), "point_down"), nullptr);
}

TEST_F(FullViewCell, IsAButtonAsAPictureOrAnIcon) {
  build(large("image/png", photo.c_str()), ZQV_VIEW_FULL_SENDER);
  EXPECT_NE(evas_object_data_get(part("thumbnail"), "point_down"), nullptr);
  build(large("application/pdf", photo.c_str()), ZQV_VIEW_FULL_SENDER);
  EXPECT_NE(evas_object_data_get(part("logo"), "point_down"), nullptr);
}

TEST_F(FullViewCell, IsDimmedOnASentShareWhoseFileIsMissing) {
  ZQViewerThumbnailItem& item = large("application/pdf", photo.c_str());
  replaceText(&item.thumbPath, "/no/such/file.png");
  build(item, ZQV_VIEW_FULL_SENDER);
  EXPECT_EQ(alphaOf(part("logo")), 127);
  EXPECT_EQ(alphaOf(part("filename")), 127);
  EXPECT_EQ(alphaOf(part("filesize")), 127);
  build(item, ZQV_VIEW_FULL_RECEIVER);
  EXPECT_EQ(alphaOf(part("logo")), 255);
}

TEST_F(FullViewCell, HasContentInOnePartOnly) {
  EXPECT_EQ(contentOf(large("image/png", nullptr), "elm.swallow.end", ZQV_VIEW_FULL_RECEIVER),
            nullptr);
}

}  // namespace
