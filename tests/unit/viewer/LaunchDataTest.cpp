#include "ViewerTest.h"
#include "ZQVIcons.h"
#include "ZQVLocalList.h"
#include "ZQVThumbItem.h"

namespace {

constexpr const char* kPhoto = "/opt/usr/media/Images/photo.jpg";
constexpr const char* kFilm = "/opt/usr/media/Videos/film.mp4";
constexpr const char* kThumb = "/opt/usr/media/.thumb/photo.png";

class LaunchData : public ViewerTest {
 protected:
  void SetUp() override {
    ViewerTest::SetUp();
    platform().mimeTypes = {{"jpg", "image/jpeg"},
                            {"mp4", "video/mp4"},
                            {"pdf", "application/pdf"},
                            {"mp3", "audio/mpeg"}};
    platform().files = {{kPhoto, 1000}, {kFilm, 2000}};
  }
  void TearDown() override {
    for (ZQViewerThumbnailItem* item : items()) delete item;
    eina_list_free(_list);
    EXPECT_EQ(platform().mediaConnections, 0);
    EXPECT_EQ(platform().openMediaHandles, 0);
  }

  void read(const std::vector<const char*>& paths) {
    ZQVLocalList::append(paths.data(), static_cast<int>(paths.size()), &_list, &total);
  }
  std::vector<ZQViewerThumbnailItem*> items() const {
    std::vector<ZQViewerThumbnailItem*> all;
    for (const Eina_List* node = _list; node; node = node->next) {
      all.push_back(static_cast<ZQViewerThumbnailItem*>(node->data));
    }
    return all;
  }

  Eina_List* _list = nullptr;
  uint64_t total = 7;
};

TEST_F(LaunchData, BecomesOneItemPerFile) {
  read({kPhoto, kFilm});
  ASSERT_EQ(items().size(), 2u);
  EXPECT_STREQ(items()[0]->fileName, "photo.jpg");
  EXPECT_STREQ(items()[0]->filePath, kPhoto);
  EXPECT_STREQ(items()[0]->mimeType, "image/jpeg");
  EXPECT_EQ(items()[0]->fileSize, 1000u);
  EXPECT_EQ(items()[1]->index, 1);
  EXPECT_EQ(total, 3007u);
}

TEST_F(LaunchData, IsNothingForNoFiles) {
  ZQVLocalList::append(nullptr, 0, &_list, &total);
  ZQVLocalList::append(nullptr, -1, &_list, &total);
  EXPECT_TRUE(items().empty());
  EXPECT_TRUE(errors().empty());
}

TEST_F(LaunchData, SkipsAMissingPath) {
  read({nullptr, kPhoto});
  ASSERT_EQ(items().size(), 1u);
  EXPECT_EQ(items()[0]->index, 1);
  EXPECT_EQ(errors()[0], "arrayValue[0] is NULL");
}

TEST_F(LaunchData, SkipsAPathWithoutADot) {
  platform().files["/opt/usr/media/README"] = 5;
  read({"/opt/usr/media/README"});
  EXPECT_TRUE(items().empty());
  EXPECT_EQ(errors(), Errors({"name[0] is NULL"}));
}

TEST_F(LaunchData, SkipsAnEmptyOrMissingFile) {
  read({"/opt/usr/media/gone.jpg"});
  EXPECT_TRUE(items().empty());
  EXPECT_EQ(errors().back(), "service error! fileSize is 0!");
  EXPECT_EQ(total, 7u);
}

TEST_F(LaunchData, CallsAnUnknownExtensionUnknown) {
  platform().files["/opt/usr/media/x.qqq"] = 5;
  read({"/opt/usr/media/x.qqq"});
  EXPECT_STREQ(items()[0]->mimeType, "unknown");
  EXPECT_STREQ(items()[0]->thumbPath, ZQV_FILE_ICON_DIR "80x80/zq_file_ic_unknown.png");
  EXPECT_STREQ(items()[0]->largePath, ZQV_LARGE_UNKNOWN_ICON);
  EXPECT_EQ(items()[0]->thumbUrl, nullptr);
}

TEST_F(LaunchData, TakesTheMediaThumbnailOfAPicture) {
  platform().media[kPhoto] = kThumb;
  read({kPhoto});
  EXPECT_STREQ(items()[0]->thumbPath, kThumb);
  EXPECT_STREQ(items()[0]->largePath, kThumb);
  EXPECT_STREQ(items()[0]->thumbUrl, kThumb);
  EXPECT_TRUE(errors().empty());
}

TEST_F(LaunchData, ShowsAPictureItselfWithoutAMediaThumbnail) {
  platform().media[kPhoto] = Text();
  read({kPhoto});
  EXPECT_STREQ(items()[0]->thumbPath, kPhoto);
  EXPECT_STREQ(items()[0]->largePath, kPhoto);
  EXPECT_STREQ(items()[0]->thumbUrl, kPhoto);
}

TEST_F(LaunchData, ShowsTheImageIconOfAFilmWithoutAThumbnail) {
  read({kFilm});
  EXPECT_STREQ(items()[0]->thumbPath, ZQV_SMALL_IMG_ICON);
  EXPECT_STREQ(items()[0]->largePath, ZQV_LARGE_IMG_ICON);
  EXPECT_STREQ(items()[0]->thumbUrl, kFilm);
  EXPECT_FALSE(items()[0]->noThumbnail);
  EXPECT_EQ(errors(), Errors({"all_item_list is NULL"}));
}

TEST_F(LaunchData, ShowsTheMediaThumbnailOfAFilm) {
  platform().media[kFilm] = kThumb;
  read({kFilm});
  EXPECT_STREQ(items()[0]->thumbPath, kThumb);
  EXPECT_STREQ(items()[0]->thumbUrl, kFilm);
}

TEST_F(LaunchData, ShowsMusicWithTheMusicIcons) {
  platform().files["/opt/usr/media/song.mp3"] = 5;
  read({"/opt/usr/media/song.mp3"});
  EXPECT_STREQ(items()[0]->thumbPath, ZQV_FILE_ICON_DIR "80x80/zq_file_ic_music.png");
  EXPECT_STREQ(items()[0]->largePath, ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_music.png");
}

TEST_F(LaunchData, NamesAPathThatEndsInASlashByItsLastPiece) {
  EXPECT_EQ(ZQVLocalList::_getFilenameFromFilepath("/a/b.c//"), "b.c");
  EXPECT_EQ(ZQVLocalList::_getFilenameFromFilepath("b.c"), "b.c");
  EXPECT_EQ(ZQVLocalList::_getFilenameFromFilepath("///"), "");
  EXPECT_EQ(ZQVLocalList::_getFilenameFromFilepath(""), "");
}

TEST_F(LaunchData, CutsALongName) {
  const std::string path = "/" + std::string(4000, 'n');
  EXPECT_EQ(ZQVLocalList::_getFilenameFromFilepath(path.c_str()).size(), 511u);
}

TEST_F(LaunchData, HasNeitherNameNorSizeForNoPath) {
  EXPECT_EQ(ZQVLocalList::_getFilenameFromFilepath(nullptr), "");
  EXPECT_EQ(ZQVLocalList::_getFileSize(nullptr), -1);
  EXPECT_EQ(errors(), Errors({"file_path is NULL", "path is NULL"}));
}

TEST_F(LaunchData, AsksTheMediaDatabaseForExactlyThePath) {
  read({kPhoto});
  EXPECT_EQ(platform().mediaConditions,
            Errors({"MEDIA_PATH = '/opt/usr/media/Images/photo.jpg'|1"}));
}

TEST_F(LaunchData, DoublesAQuoteInAPath) {
  platform().files["/opt/usr/it's.jpg"] = 5;
  read({"/opt/usr/it's.jpg"});
  EXPECT_EQ(platform().mediaConditions, Errors({"MEDIA_PATH = '/opt/usr/it''s.jpg'|1"}));
}

struct MediaFailure {
  int FakePlatform::*member;
  std::vector<std::string> log;
};

TEST_F(LaunchData, GoesOnWithoutTheMediaDatabase) {
  const MediaFailure failures[] = {
      {&FakePlatform::mediaConnectError, {"connection is failed\n\n"}},
      {&FakePlatform::mediaFilterError, {"Fail to create filter: -12"}},
      {&FakePlatform::mediaConditionError, {"Fail to set condition: -12"}},
      {&FakePlatform::mediaForeachError, {"media_info_foreach_media_from_db failed: -12"}},
  };
  for (const MediaFailure& failure : failures) {
    FakeLog::get().clear();
    platform().*failure.member = -12;
    read({kPhoto});
    auto expected = failure.log;
    expected.push_back("_mediaInfoCreateByPath is failed");
    EXPECT_EQ(errors(), expected);
    EXPECT_STREQ(items().back()->thumbPath, kPhoto);
    platform().*failure.member = 0;
  }
}

TEST_F(LaunchData, LogsAThumbnailThatCannotBeRead) {
  platform().media[kPhoto] = Text();
  platform().mediaThumbnailError = -22;
  read({kPhoto});
  EXPECT_EQ(errors(), Errors({"media_info_get_thumbnail_path failed: -22"}));
}

TEST_F(LaunchData, LogsAConnectionThatCannotBeClosed) {
  platform().media[kPhoto] = kThumb;
  platform().mediaDisconnectError = -1;
  read({kPhoto});
  EXPECT_EQ(errors(), Errors({"disconnection is failed\n\n"}));
  EXPECT_STREQ(items()[0]->thumbPath, kThumb);
}

}  // namespace
