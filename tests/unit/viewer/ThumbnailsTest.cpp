#include <Elementary.h>

#include "../views/Items.h"
#include "ViewerTest.h"
#include "ZQVIcons.h"
#include "ZQVThumbnailFetcher.h"

namespace {

constexpr const char* kNormalFolder = "/opt/usr/apps/com.orlant.zelqo/shared/data/thumbnail";
constexpr const char* kMidFolder = "/opt/usr/apps/com.orlant.zelqo/shared/data/fullview_thumbnail";
constexpr const char* kNormalPicture = "/opt/usr/apps/com.orlant.zelqo/shared/data/thumbnail/0.png";
constexpr const char* kMidPicture =
    "/opt/usr/apps/com.orlant.zelqo/shared/data/fullview_thumbnail/0.png";

class Thumbnails : public ViewerTest {
 protected:
  /// A share of photos; each with its own two pictures and address at the service.
  void share(int count) {
    for (int i = 0; i < count; ++i) addPhoto(i);
    fetcher.setShare(items.list(), "token");
  }
  ZQViewerThumbnailItem& addPhoto(int serviceIndex) {
    const std::string number = std::to_string(serviceIndex);
    FakeFile file;
    file.url = "http://s/file/" + number;
    service.files.resize(static_cast<size_t>(serviceIndex) + 1);
    service.files[static_cast<size_t>(serviceIndex)] = file;
    ZQViewerThumbnailItem& item = items.add("photo" + number + ".jpg", 1000);
    replaceText(&item.mimeType, "image/jpeg");
    replaceText(&item.thumbPath, ZQV_SMALL_IMG_ICON);
    replaceText(&item.largePath, ZQV_LARGE_IMG_ICON);
    replaceText(&item.thumbUrl, ("http://s/thumb/" + number).c_str());
    replaceText(&item.midThumbUrl, ("http://s/mid/" + number).c_str());
    item.index = serviceIndex;
    return item;
  }
  void requestNormal() {
    fetcher._getContentInfoNReqNormalThumbnail(reinterpret_cast<zelqo_share_h>(&service));
  }
  void requestMid() { fetcher._reqMidThumbnail(reinterpret_cast<zelqo_share_h>(&service)); }
  void arrive(const char* path, const std::string& url) {
    ZQVThumbnailFetcher::_SAPIDownloadCb(1, 0, path, url.c_str(), 0, &fetcher);
  }
  /// Shows all items in a grid of this kind.
  void show(ZQVViewType viewType) {
    if (!window) window = elm_win_add(nullptr, "test", ELM_WIN_BASIC);
    Evas_Object* grid = elm_gengrid_add(window);
    for (size_t i = 0; i < items.size(); ++i) {
      items[i].gridItems[viewType] =
          elm_gengrid_item_append(grid, items[i].getItemClass(), &items[i], nullptr, nullptr);
    }
  }
  void TearDown() override {
    if (window) evas_object_del(window);
    EXPECT_EQ(platform().openContactHandles, 0);
  }

  FakeShare service;
  Items items;
  ZQVThumbnailFetcher fetcher;
  Evas_Object* window = nullptr;
};

TEST_F(Thumbnails, AreRequestedFromTheServiceOnAFirstVisit) {
  share(2);
  requestNormal();
  ASSERT_EQ(platform().downloads.size(), 1u);
  const FakeDownload& download = platform().downloads[0];
  EXPECT_EQ(download.urls, Errors({"http://s/thumb/0", "http://s/thumb/1"}));
  EXPECT_EQ(download.folder, kNormalFolder);
  EXPECT_EQ(download.priority, 1);
  EXPECT_EQ(download.flags, 0);
  EXPECT_EQ(traces(), Errors({"Going to downloading normal thumbnail"}));
  EXPECT_EQ(platform().madeFolders, Errors({kNormalFolder}));
  requestMid();
  ASSERT_EQ(platform().downloads.size(), 2u);
  EXPECT_EQ(platform().downloads[1].urls, Errors({"http://s/mid/0", "http://s/mid/1"}));
  EXPECT_EQ(platform().downloads[1].folder, kMidFolder);
  EXPECT_EQ(traces().back(), "Going to downloading mid thumbnail");
}

TEST_F(Thumbnails, NeedAShare) {
  fetcher._getContentInfoNReqNormalThumbnail(nullptr);
  fetcher._reqMidThumbnail(nullptr);
  EXPECT_EQ(errors(), Errors({"handle is NULL", "handle is NULL"}));
}

TEST_F(Thumbnails, GiveEachFileItsAddressAndTheIconOfItsType) {
  share(2);
  replaceText(&items[1].mimeType, "audio/mpeg");
  service.files[1].type = "audio/mpeg";
  requestNormal();
  requestMid();
  EXPECT_STREQ(items[0].downloadUrl, "http://s/file/0");
  EXPECT_STREQ(items[1].downloadUrl, "http://s/file/1");
  EXPECT_STREQ(items[0].thumbPath, ZQV_SMALL_IMG_ICON);
  EXPECT_STREQ(items[1].thumbPath, ZQV_FILE_ICON_DIR "80x80/zq_file_ic_music.png");
  EXPECT_STREQ(items[1].largePath, ZQV_FILE_ICON_DIR "148x148/zq_file_full_ic_music.png");
}

TEST_F(Thumbnails, AskTheServiceByTheFilesOwnNumberWhenFilesWereLeftOut) {
  addPhoto(0);
  addPhoto(2);
  service.files[1].url = "http://s/file/1";
  fetcher.setShare(items.list(), "token");
  requestNormal();
  EXPECT_EQ(platform().askedUrls, (std::vector<unsigned int>{0, 2}));
  EXPECT_STREQ(items[1].downloadUrl, "http://s/file/2");
  EXPECT_EQ(items[1].index, 1);
  service.files[1].type.reset();
  requestMid();
  EXPECT_TRUE(errors().empty());
}

TEST_F(Thumbnails, LeaveAnAddressThatCannotBeReadEmpty) {
  share(1);
  service.files[0].url.reset();
  requestNormal();
  EXPECT_EQ(items[0].downloadUrl, nullptr);
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(Thumbnails, AreReusedFromAnEarlierVisit) {
  share(2);
  platform().preferences["http://s/thumb/0"] = kNormalPicture;
  platform().files[kNormalPicture] = 100;
  requestNormal();
  EXPECT_STREQ(items[0].thumbPath, kNormalPicture);
  EXPECT_EQ(platform().downloads[0].urls, Errors({"http://s/thumb/1"}));
}

TEST_F(Thumbnails, AreRequestedAgainWhenTheFileIsGone) {
  share(1);
  platform().preferences["http://s/thumb/0"] = kNormalPicture;
  requestNormal();
  EXPECT_EQ(platform().downloads[0].urls, Errors({"http://s/thumb/0"}));
  EXPECT_EQ(platform().preferences.count("http://s/thumb/0"), 0u);
  EXPECT_STREQ(items[0].thumbPath, ZQV_SMALL_IMG_ICON);
}

TEST_F(Thumbnails, OfMidSizeAreReusedWithoutALookAtTheFile) {
  share(2);
  platform().preferences["http://s/mid/0"] = kMidPicture;
  platform().preferences["http://s/mid/1"] = "";
  requestMid();
  EXPECT_STREQ(items[0].largePath, kMidPicture);
  EXPECT_STREQ(items[1].largePath, ZQV_LARGE_IMG_ICON);
  EXPECT_TRUE(platform().downloads.empty());
}

TEST_F(Thumbnails, OfACompleteShareAreNotRequested) {
  share(1);
  platform().preferences["token"] = "downloaded";
  requestNormal();
  EXPECT_TRUE(platform().downloads.empty());
  EXPECT_EQ(FakeClock::running(), 0);
  platform().preferences["token"] = "something else";
  requestNormal();
  EXPECT_EQ(platform().downloads.size(), 1u);
}

TEST_F(Thumbnails, WithoutAnAddressAreNeitherLookedUpNorRequested) {
  share(1);
  replaceText(&items[0].thumbUrl, nullptr);
  replaceText(&items[0].midThumbUrl, nullptr);
  requestNormal();
  requestMid();
  EXPECT_TRUE(platform().downloads.empty());
  EXPECT_TRUE(traces().empty());
}

TEST_F(Thumbnails, OfMidSizeAreNotRequestedWhenATypeCannotBeRead) {
  share(2);
  service.files[1].type.reset();
  requestMid();
  EXPECT_TRUE(platform().downloads.empty());
  EXPECT_EQ(errors(), Errors({"zelqo_content_info_get_content_type"}));
}

TEST_F(Thumbnails, AreNotRequestedWithoutAFolder) {
  share(1);
  platform().foldersCanBeMade = false;
  requestNormal();
  requestMid();
  EXPECT_TRUE(platform().downloads.empty());
  EXPECT_EQ(errors(),
            Errors({std::string("create ") + kNormalFolder + " failed. errno: Permission denied",
                    std::string("thumbnail_path didnot exist and create failed: ") + kNormalFolder,
                    std::string("create ") + kMidFolder + " failed. errno: Permission denied",
                    std::string("failed to create [") + kMidFolder + "]"}));
}

TEST_F(Thumbnails, LogARefusedRequest) {
  share(1);
  platform().downloadError = -22;
  requestNormal();
  requestMid();
  EXPECT_EQ(errors(), Errors({"zelqo_request_download", "zelqo_request_download"}));
}

TEST_F(Thumbnails, GoOnTheItemAndIntoThePreferencesWhenTheyArrive) {
  share(2);
  requestNormal();
  arrive(kNormalPicture, "http://s/thumb/0");
  EXPECT_STREQ(items[0].thumbPath, kNormalPicture);
  EXPECT_EQ(platform().preferences["http://s/thumb/0"], kNormalPicture);
  EXPECT_STREQ(items[1].thumbPath, ZQV_SMALL_IMG_ICON);
  EXPECT_EQ(traces().back(), "111");
}

TEST_F(Thumbnails, KeepAPreferenceThatIsThere) {
  share(1);
  platform().preferences["http://s/thumb/0"] = "/elsewhere.png";
  arrive(kNormalPicture, "http://s/thumb/0");
  EXPECT_EQ(platform().preferences["http://s/thumb/0"], "/elsewhere.png");
}

TEST_F(Thumbnails, StandInForTheLargePictureUntilThatArrives) {
  share(1);
  arrive(kNormalPicture, "http://s/thumb/0");
  EXPECT_STREQ(items[0].largePath, kNormalPicture);
  arrive(kMidPicture, "http://s/mid/0");
  EXPECT_STREQ(items[0].largePath, kMidPicture);
  arrive(kNormalPicture, "http://s/thumb/0");
  EXPECT_STREQ(items[0].largePath, kMidPicture);
}

TEST_F(Thumbnails, AreCompleteWhenThatOfTheLastFileArrives) {
  share(3);
  arrive(kNormalPicture, "http://s/thumb/0");
  EXPECT_EQ(platform().preferences.count("token"), 0u);
  arrive(kMidPicture, "http://s/mid/2");
  EXPECT_EQ(platform().preferences.count("token"), 0u);
  arrive(kNormalPicture, "http://s/thumb/2");
  EXPECT_EQ(platform().preferences["token"], "downloaded");
}

TEST_F(Thumbnails, ForAnUnknownAddressChangeNothing) {
  share(1);
  arrive(kNormalPicture, "http://s/other");
  EXPECT_STREQ(items[0].thumbPath, ZQV_SMALL_IMG_ICON);
  EXPECT_TRUE(platform().preferences.empty());
}

TEST_F(Thumbnails, ArriveWithAllTheirArguments) {
  ZQVThumbnailFetcher::_SAPIDownloadCb(1, 0, kNormalPicture, "url", 0, nullptr);
  ZQVThumbnailFetcher::_SAPIDownloadCb(1, 0, kNormalPicture, nullptr, 0, &fetcher);
  ZQVThumbnailFetcher::_SAPIDownloadCb(1, -1, nullptr, "url", 0, &fetcher);
  EXPECT_EQ(errors(), Errors({"!user_data", "!thumb_url", "!download_path"}));
}

TEST_F(Thumbnails, RefreshTheGridOnceAfterTheLastOfABurst) {
  share(200);
  show(ZQV_VIEW_RECEIVER);
  for (int i = 0; i < 200; ++i) {
    arrive(kNormalPicture, "http://s/thumb/" + std::to_string(i));
    FakeClock::advance(0.01);
  }
  EXPECT_EQ(platform().gridRefreshes, 0);
  FakeClock::advance(0.78);
  EXPECT_EQ(platform().gridRefreshes, 0);
  FakeClock::advance(0.02);
  EXPECT_EQ(platform().gridRefreshes, 1);
  FakeClock::advance(10);
  EXPECT_EQ(platform().gridRefreshes, 1);
}

TEST_F(Thumbnails, RefreshTheFullViewWhereItIsOpen) {
  share(1);
  show(ZQV_VIEW_RECEIVER);
  show(ZQV_VIEW_FULL_RECEIVER);
  arrive(kMidPicture, "http://s/mid/0");
  FakeClock::advance(0.8);
  EXPECT_EQ(platform().gridRefreshes, 1);
  replaceText(&items[0].largePath, ZQV_LARGE_IMG_ICON);
  arrive(kNormalPicture, "http://s/thumb/0");
  FakeClock::advance(0.8);
  EXPECT_EQ(platform().gridRefreshes, 3);
}

TEST_F(Thumbnails, RefreshNothingWhenThePageHasGoneMeanwhile) {
  share(1);
  show(ZQV_VIEW_RECEIVER);
  arrive(kNormalPicture, "http://s/thumb/0");
  items[0].gridItems[ZQV_VIEW_RECEIVER] = nullptr;
  FakeClock::advance(1);
  EXPECT_EQ(platform().gridRefreshes, 0);
}

TEST_F(Thumbnails, RefreshNothingWhenTheShareHasGoneMeanwhile) {
  share(1);
  show(ZQV_VIEW_RECEIVER);
  arrive(kNormalPicture, "http://s/thumb/0");
  fetcher.forgetShare();
  EXPECT_EQ(FakeClock::running(), 0);
  arrive(kNormalPicture, "http://s/thumb/0");
  EXPECT_EQ(platform().gridRefreshes, 0);
}

TEST_F(Thumbnails, AreMissedAfter40SecondsOfSilence) {
  share(1);
  requestNormal();
  requestMid();
  FakeClock::advance(39.9);
  EXPECT_TRUE(errors().empty());
  FakeClock::advance(0.1);
  EXPECT_EQ(errors(),
            Errors({"service error orrured, more than 40sec still not download thumbnail.",
                    "service error orrured, more than 40sec still not download mid-thumbnail."}));
  EXPECT_STREQ(items[0].thumbPath, ZQV_SMALL_IMG_ICON);
  FakeClock::advance(100);
  EXPECT_EQ(errors().size(), 2u);
}

TEST_F(Thumbnails, OfABatchAreNoLongerMissedOnceOneHasArrived) {
  share(2);
  requestNormal();
  requestMid();
  arrive(kNormalPicture, "http://s/thumb/0");
  FakeClock::advance(41);
  EXPECT_EQ(errors(), Errors({"service error orrured, more than 40sec still not download "
                              "mid-thumbnail."}));
}

TEST_F(Thumbnails, AreNotMissedAfterTheEnd) {
  share(1);
  requestNormal();
  requestMid();
  fetcher.stopWatchdogs();
  FakeClock::advance(41);
  EXPECT_TRUE(errors().empty());
}

class DownloadedFiles : public Thumbnails {};

TEST_F(DownloadedFiles, AreKnownFromTheFileManagersRecord) {
  share(2);
  platform().recordedFiles = {{"http://s/file/0", "/opt/usr/media/Downloads/photo0 (1).jpg"},
                              {"http://s/file/1", "/opt/usr/media/Downloads/gone.jpg"}};
  platform().files["/opt/usr/media/Downloads/photo0 (1).jpg"] = 1;
  requestNormal();
  EXPECT_EQ(items[0].downloadStatus, ZQV_DOWNLOADED);
  EXPECT_EQ(items[1].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadedFiles, AreLookedForByNameOnlyWithoutARecord) {
  share(2);
  platform().files = {{"/opt/usr/media/Downloads/photo0.jpg", 1},
                      {"/opt/usr/media/Downloads/photo1.jpg", 1}};
  platform().preferences = {{"http://s/file/0", "http://s/file/0"},
                            {"http://s/file/1", "http://s/file/1"}};
  platform().recordedFiles["http://s/file/1"] = "/opt/usr/media/Downloads/gone.jpg";
  requestNormal();
  EXPECT_EQ(items[0].downloadStatus, ZQV_DOWNLOADED);
  EXPECT_EQ(items[1].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadedFiles, AreNotThoseOfTheSameNameFromElsewhere) {
  share(2);
  platform().files = {{"/opt/usr/media/Downloads/photo0.jpg", 1},
                      {"/opt/usr/media/Downloads/photo1.jpg", 1}};
  platform().preferences["http://s/file/1"] = "http://s/another";
  requestNormal();
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
  EXPECT_EQ(items[1].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadedFiles, AreNeverLookedForOutsideTheFolder) {
  share(1);
  replaceText(&items[0].fileName, "../secret.jpg");
  platform().files["/opt/usr/media/Downloads/../secret.jpg"] = 1;
  platform().preferences["http://s/file/0"] = "http://s/file/0";
  requestNormal();
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

class ThumbnailFolder : public ViewerTest {};

TEST_F(ThumbnailFolder, IsMadeWhenMissing) {
  EXPECT_TRUE(ZQVThumbnailFetcher::_checkAndCreateFolder(kNormalFolder));
  EXPECT_TRUE(ZQVThumbnailFetcher::_checkAndCreateFolder(kNormalFolder));
  EXPECT_EQ(platform().madeFolders, Errors({kNormalFolder}));
  EXPECT_TRUE(platform().changedModes.empty());
}

TEST_F(ThumbnailFolder, IsMadeWritableForEveryone) {
  platform().files[kNormalFolder] = 4096;
  platform().foldersAreWritable = false;
  EXPECT_TRUE(ZQVThumbnailFetcher::_checkAndCreateFolder(kNormalFolder));
  EXPECT_EQ(platform().changedModes, Errors({std::string(kNormalFolder) + " 511"}));
}

TEST_F(ThumbnailFolder, MustBeWritable) {
  platform().files[kNormalFolder] = 4096;
  platform().foldersAreWritable = false;
  platform().chmodError = EPERM;
  EXPECT_FALSE(ZQVThumbnailFetcher::_checkAndCreateFolder(kNormalFolder));
  EXPECT_EQ(errors(), Errors({std::string("chmod ") + kNormalFolder +
                              " failed. errno: Operation not permitted"}));
}

TEST_F(ThumbnailFolder, NeedsAPath) {
  EXPECT_FALSE(ZQVThumbnailFetcher::_checkAndCreateFolder(nullptr));
  EXPECT_EQ(errors(), Errors({"folder path is NULL"}));
}

}  // namespace
