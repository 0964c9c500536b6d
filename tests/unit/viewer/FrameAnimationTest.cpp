#include "PageTest.h"
#include "ZQVCommon.h"
#include "ZQVFrames.h"

namespace {

class FrameAnimation : public PageTest {
 protected:
  void SetUp() override {
    PageTest::SetUp();
    for (int i = 0; i < 7; ++i) {
      _paths[i] = picture(("frame" + std::to_string(i) + ".png").c_str());
      frames[i] = _paths[i].c_str();
    }
  }
  Evas_Object* create(const char** list) {
    return ZQViewerCommon::getInstance().createGif(window, list);
  }
  static std::string fileOf(Evas_Object* image) {
    const char* file = nullptr;
    elm_image_file_get(image, &file, nullptr);
    return file ? file : "";
  }

  const char* frames[8] = {};

 private:
  std::string _paths[7];
};

TEST_F(FrameAnimation, ShowsItsFramesOneAfterTheOtherAndBeginsAgain) {
  Evas_Object* image = create(frames);
  EXPECT_EQ(fileOf(image), frames[0]);
  for (int step = 1; step <= 15; ++step) {
    FakeClock::advance(0.3);
    EXPECT_EQ(fileOf(image), frames[step % 7]) << step;
  }
  evas_object_del(image);
}

TEST_F(FrameAnimation, HasTheNaturalSizeOfItsFrame) {
  Evas_Object* image = create(frames);
  int width = 0, height = 0;
  evas_object_size_hint_min_get(image, &width, &height);
  EXPECT_EQ(width, 8);
  EXPECT_EQ(height, 8);
  evas_object_geometry_get(image, nullptr, nullptr, &width, &height);
  EXPECT_EQ(width, 8);
  evas_object_del(image);
}

TEST_F(FrameAnimation, OfOneFrameShowsItAgain) {
  const char* one[] = {frames[3], nullptr};
  Evas_Object* image = create(one);
  FakeClock::advance(0.9);
  EXPECT_EQ(fileOf(image), frames[3]);
  evas_object_del(image);
}

TEST_F(FrameAnimation, ShowsTheSecondFrameOfANewListNext) {
  Evas_Object* image = create(frames);
  FakeClock::advance(0.9);
  const char* others[] = {frames[5], frames[6], nullptr};
  ZQViewerCommon::getInstance().updateGif(image, others);
  EXPECT_EQ(fileOf(image), frames[3]);
  FakeClock::advance(0.3);
  EXPECT_EQ(fileOf(image), frames[6]);
  FakeClock::advance(0.3);
  EXPECT_EQ(fileOf(image), frames[5]);
  evas_object_del(image);
}

TEST_F(FrameAnimation, EndsWithItsImage) {
  const int before = FakeClock::running();
  Evas_Object* image = create(frames);
  EXPECT_EQ(FakeClock::running(), before + 1);
  evas_object_del(image);
  EXPECT_EQ(FakeClock::running(), before);
  EXPECT_TRUE(errors().empty());
}

TEST_F(FrameAnimation, NeedsFrames) {
  const char* none[] = {nullptr};
  EXPECT_EQ(create(nullptr), nullptr);
  EXPECT_EQ(create(none), nullptr);
  Evas_Object* image = create(frames);
  ZQViewerCommon::getInstance().updateGif(image, nullptr);
  EXPECT_EQ(errors(), Errors({"!png_list", "!png_list", "!png_list"}));
  evas_object_del(image);
}

TEST_F(FrameAnimation, ChangesNothingOnAnImageThatIsNone) {
  Evas_Object* plain = elm_image_add(window);
  elm_image_file_set(plain, frames[0], nullptr);
  ZQViewerCommon::getInstance().updateGif(plain, frames);
  ZQViewerCommon::getInstance().updateGif(nullptr, frames);
  FakeClock::advance(1);
  EXPECT_EQ(fileOf(plain), frames[0]);
  evas_object_del(plain);
}

TEST_F(FrameAnimation, HasSevenPicturesOfADownload) {
  for (const char** list : {zqvDownloadingSmallFrames, zqvDownloadingLargeFrames}) {
    int count = 0;
    while (list[count]) ++count;
    EXPECT_EQ(count, 7);
  }
  EXPECT_STREQ(zqvDownloadingSmallFrames[6],
               "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/"
               "zq_ic_download_progress/31/zq_ic_download_process06.png");
  EXPECT_STREQ(zqvDownloadingLargeFrames[0],
               "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/"
               "zq_ic_download_progress/55/zq_ic_download_process_02_00.png");
  EXPECT_STREQ(zqvDownloadedSmallFrames[0],
               "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/"
               "zq_ic_downloaded_02.png");
  EXPECT_EQ(zqvDownloadedLargeFrames[1], nullptr);
}

}  // namespace
