#include "../views/Items.h"
#include "ViewerTest.h"
#include "ZQVAccess.h"
#include "ZQVGridFiller.h"
#include "ZQVGridMetrics.h"

namespace {

class GridFiller : public ViewerTest {
 protected:
  void start() {
    _filler.start(items.list(), [this](ZQViewerThumbnailItem*) { ++appended; });
  }
  Items items;
  int appended = 0;
  ZQVGridFiller _filler;
};

TEST_F(GridFiller, AppendsUpTo19FilesAtOnce) {
  items.addCount(19);
  start();
  EXPECT_EQ(appended, 19);
  EXPECT_FALSE(_filler.isRunning());
}

TEST_F(GridFiller, Appends20FilesInTwoBatches) {
  items.addCount(20);
  start();
  EXPECT_EQ(appended, 0);
  FakeClock::advance(0.01);
  EXPECT_EQ(appended, 11);
  FakeClock::advance(0.01);
  EXPECT_EQ(appended, 20);
  EXPECT_FALSE(_filler.isRunning());
}

TEST_F(GridFiller, StopsAfterAFullLastBatch) {
  items.addCount(22);
  start();
  FakeClock::advance(0.02);
  EXPECT_EQ(appended, 22);
  EXPECT_FALSE(_filler.isRunning());
}

TEST_F(GridFiller, SkipsMissingFilesWhichStillTakeAPlace) {
  for (int i = 0; i < 5; ++i) items.addNothing();
  items.addCount(20);
  start();
  FakeClock::advance(0.01);
  EXPECT_EQ(appended, 6);
  FakeClock::advance(0.05);
  EXPECT_EQ(appended, 20);
}

TEST_F(GridFiller, DoesNothingWithoutFiles) {
  start();
  EXPECT_EQ(appended, 0);
  EXPECT_FALSE(_filler.isRunning());
}

TEST_F(GridFiller, StopsWithItsPage) {
  items.addCount(30);
  start();
  _filler.stop();
  FakeClock::advance(1);
  EXPECT_EQ(appended, 0);
}

TEST(CellSide, IsAQuarterOfThePortraitAndASeventhOfTheLandscape) {
  EXPECT_EQ(zqvCellSideFor(720, 1280, 0), 180);
  EXPECT_EQ(zqvCellSideFor(720, 1280, 180), 180);
  EXPECT_EQ(zqvCellSideFor(720, 1280, 90), 182);
  EXPECT_EQ(zqvCellSideFor(720, 1280, 270), 182);
}

TEST(CellName, SaysNameSizeKindAndState) {
  Items items;
  ZQViewerThumbnailItem& item = items.add("a<b>.pdf", 1536);
  EXPECT_EQ(zqvCellName(item), "a<b>.pdf, 1.5KB, PDF, not downloaded");
  item.downloadStatus = ZQV_REQUESTED;
  EXPECT_EQ(zqvCellName(item), "a<b>.pdf, 1.5KB, PDF, requested");
  item.downloadStatus = ZQV_DOWNLOADING;
  EXPECT_EQ(zqvCellName(item), "a<b>.pdf, 1.5KB, PDF, downloading");
  item.downloadStatus = ZQV_DOWNLOADED;
  EXPECT_EQ(zqvCellName(item), "a<b>.pdf, 1.5KB, PDF, downloaded");
}

TEST(CellName, TellsAMissingFileOfThisPhone) {
  Items items;
  ZQViewerThumbnailItem& item = items.add("a.pdf", 1);
  item.filePath = g_strdup("/a.pdf");
  EXPECT_EQ(zqvCellName(item), "a.pdf, 1.0B, PDF, on this phone");
  item.noThumbnail = true;
  EXPECT_EQ(zqvCellName(item), "a.pdf, 1.0B, PDF, missing");
}

TEST(CellName, IsValidUtf8WhateverTheFileIsCalled) {
  Items items;
  const std::string name = zqvCellName(items.add("\xff\xfe.pdf", 1));
  EXPECT_TRUE(g_utf8_validate(name.c_str(), -1, nullptr));
}

TEST(SharedFile, BeginsEmptyAndWithoutAPosition) {
  const ZQViewerThumbnailItem item;
  EXPECT_EQ(item.index, -1);
  EXPECT_EQ(item.downloadStatus, ZQV_NOT_DOWNLOADED);
  EXPECT_FALSE(item.checked);
  EXPECT_FALSE(item.noThumbnail);
  EXPECT_EQ(item.fileSize, 0u);
  for (const char* text : {item.thumbPath, item.largePath, item.thumbUrl, item.midThumbUrl,
                           item.downloadUrl, item.fileName, item.mimeType, item.filePath}) {
    EXPECT_EQ(text, nullptr);
  }
  for (const Elm_Object_Item* cell : item.gridItems) EXPECT_EQ(cell, nullptr);
}

}  // namespace
