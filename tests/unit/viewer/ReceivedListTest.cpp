#include "ViewerTest.h"
#include "ZQVIcons.h"
#include "ZQVReceivedList.h"
#include "ZQVThumbItem.h"

namespace {

class ReceivedList : public ViewerTest {
 protected:
  void TearDown() override {
    for (ZQViewerThumbnailItem* item : items()) delete item;
    eina_list_free(_list);
  }

  uint32_t read() {
    return ZQVReceivedList::append(reinterpret_cast<zelqo_share_h>(&share),
                                   static_cast<uint32_t>(share.files.size()), &_list);
  }
  std::vector<ZQViewerThumbnailItem*> items() const {
    std::vector<ZQViewerThumbnailItem*> all;
    for (const Eina_List* node = _list; node; node = node->next) {
      all.push_back(static_cast<ZQViewerThumbnailItem*>(node->data));
    }
    return all;
  }
  static FakeFile file() {
    FakeFile file;
    file.thumb = "http://s/thumb";
    file.mid = "http://s/mid";
    return file;
  }

  FakeShare share;
  Eina_List* _list = nullptr;
};

TEST_F(ReceivedList, HasOneItemPerFileInShareOrder) {
  share.files = {file(), file()};
  share.files[1].name = "film.mp4";
  share.files[1].type = "video/mp4";
  share.files[1].size = 4000000000u;
  EXPECT_EQ(read(), 0u);
  ASSERT_EQ(items().size(), 2u);
  const ZQViewerThumbnailItem& second = *items()[1];
  EXPECT_STREQ(second.fileName, "film.mp4");
  EXPECT_STREQ(second.mimeType, "video/mp4");
  EXPECT_EQ(second.fileSize, 4000000000u);
  EXPECT_EQ(second.index, 1);
  EXPECT_EQ(second.downloadStatus, ZQV_NOT_DOWNLOADED);
  EXPECT_FALSE(second.checked);
  EXPECT_TRUE(errors().empty());
}

TEST_F(ReceivedList, ShowsTheImageIconsUntilPicturesArrive) {
  share.files = {file()};
  share.files[0].type = "application/pdf";
  read();
  EXPECT_STREQ(items()[0]->thumbPath, ZQV_SMALL_IMG_ICON);
  EXPECT_STREQ(items()[0]->largePath, ZQV_LARGE_IMG_ICON);
  EXPECT_STREQ(items()[0]->downloadUrl, ZQV_LARGE_IMG_ICON);
  EXPECT_STREQ(items()[0]->thumbUrl, "http://s/thumb");
  EXPECT_STREQ(items()[0]->midThumbUrl, "http://s/mid");
}

TEST_F(ReceivedList, TakesTheBigPictureWhereThereIsNoMidSizeOne) {
  share.files = {file()};
  share.files[0].mid.reset();
  share.files[0].big = "http://s/big";
  read();
  EXPECT_STREQ(items()[0]->midThumbUrl, "http://s/big");
  EXPECT_EQ(errors(), Errors({"get mid thumbnail url[the 0th] failed from SAPI"}));
}

TEST_F(ReceivedList, KeepsAFileWithoutPictures) {
  share.files = {file()};
  share.files[0].thumb.reset();
  share.files[0].mid.reset();
  EXPECT_EQ(read(), 0u);
  EXPECT_EQ(items()[0]->thumbUrl, nullptr);
  EXPECT_EQ(items()[0]->midThumbUrl, nullptr);
  EXPECT_EQ(errors(), Errors({"get thumbnail url[the 0th] failed from SAPI",
                              "get mid thumbnail url[the 0th] failed from SAPI",
                              "get big thumbnail url[the 0th] failed from SAPI"}));
}

TEST_F(ReceivedList, LeavesOutAFileWithoutName) {
  share.files = {file(), file(), file()};
  share.files[1].name.reset();
  EXPECT_EQ(read(), 1u);
  ASSERT_EQ(items().size(), 2u);
  EXPECT_EQ(items()[1]->index, 2);
  EXPECT_EQ(errors(), Errors({"service error! get fileName[the 1th] failed from SAPI!"}));
}

TEST_F(ReceivedList, LeavesOutAFileWithoutSize) {
  share.files = {file()};
  share.files[0].size = 0;
  EXPECT_EQ(read(), 1u);
  EXPECT_EQ(errors(), Errors({"service error! get fileSize[the 0th] failed from SAPI!"}));
}

TEST_F(ReceivedList, LeavesOutAFileWithoutType) {
  share.files = {file()};
  share.files[0].type.reset();
  EXPECT_EQ(read(), 1u);
  EXPECT_TRUE(items().empty());
  EXPECT_EQ(errors(), Errors({"service error! get fileType[the 0th] failed from SAPI!"}));
}

TEST_F(ReceivedList, OfAnEmptyShareIsEmpty) {
  EXPECT_EQ(read(), 0u);
  EXPECT_TRUE(items().empty());
}

}  // namespace
