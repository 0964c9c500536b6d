#include "ZQVFullView.h"

#include <gio/gio.h>
#include <sys/stat.h>
#include <unistd.h>

#include <fstream>
#include <set>

#include "ViewTest.h"
#include "ZQVCommon.h"
#include "ZQVSharedFiles.h"

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

constexpr uint32_t kLimit = 6291456;
constexpr int kLanguageChanged = 13;
constexpr const char* kOpen = "IDS_RSH_BUTTON_OPEN";
constexpr const char* kDownload = "IDS_RSH_BUTTON_DOWNLOAD_ABB3";
constexpr const char* kNoProgram = "IDS_RSH_TPOP_UNABLE_TO_FIND_APPLICATION_TO_PERFORM_THIS_ACTION";
constexpr const char* kNoNetwork =
    "IDS_MF_POP_MOBILE_DATA_IS_TURNED_OFF_CONNECT_TO_A_WI_FI_NETWORK_INSTEAD_MSG";

void signalDownload(const char* member, const char* url) {
  GDBusConnection* bus = g_bus_get_sync(G_BUS_TYPE_SYSTEM, nullptr, nullptr);
  g_dbus_connection_emit_signal(bus, nullptr, "/com/orlant/remoteshare",
                                "org.tizen.call.remote.share", member, g_variant_new("(s)", url),
                                nullptr);
  g_object_unref(bus);
}

/// As in an Arabic or Hebrew interface, as long as it lives.
class FromRightToLeft {
 public:
  FromRightToLeft() { elm_config_mirrored_set(EINA_TRUE); }
  ~FromRightToLeft() { elm_config_mirrored_set(EINA_FALSE); }
};

bool isInTheMiddleOfItsGrid(Elm_Object_Item* cell) {
  Evas_Object* object = elm_object_item_track(cell);
  if (!object) return false;
  int x = 0, width = 0, left = 0, all = 0;
  evas_object_geometry_get(object, &x, nullptr, &width, nullptr);
  elm_object_item_untrack(cell);
  evas_object_geometry_get(elm_object_item_widget_get(cell), &left, nullptr, &all, nullptr);
  const int middle = left + all / 2;
  return x <= middle && middle < x + width;
}

}  // namespace

/// Which files were in the middle of the pager in the frames that were painted.
class PaintedPages {
 public:
  explicit PaintedPages(const Items& items)
      : _items(items), _canvas(evas_object_evas_get(TestApp::get().window())) {
    evas_event_callback_add(_canvas, EVAS_CALLBACK_RENDER_POST, _paintedCb, this);
  }
  ~PaintedPages() { stop(); }
  void stop() {
    evas_event_callback_del_full(_canvas, EVAS_CALLBACK_RENDER_POST, _paintedCb, this);
  }
  const std::set<int>& pages() const { return _pages; }

 private:
  static void _paintedCb(void* data, Evas*, void*) {
    auto* self = static_cast<PaintedPages*>(data);
    for (size_t i = 0; i < self->_items.size(); ++i) {
      Elm_Object_Item* cell = self->_items[i].gridItems[ZQV_VIEW_FULL_RECEIVER];
      if (cell && isInTheMiddleOfItsGrid(cell)) self->_pages.insert(static_cast<int>(i));
    }
  }

  const Items& _items;
  Evas* _canvas;
  std::set<int> _pages;
};

class FullView : public ViewTest {
 protected:
  ~FullView() override {
    for (const std::string& path : _files) remove(path.c_str());
  }

  void open(int first, int kind = ZQV_VIEW_FULL_RECEIVER) {
    view = new Watched<ZQVFullView>(&isGone, items.list(), kind, "Minji", "token-1");
    push(view, &items[first], "fullview");
    ASSERT_TRUE(isTop("ZQVFullView"));
    pager = view->getEvasObj();
    button = elm_object_item_part_content_get(view->getNaviItem(), "toolbar");
    ASSERT_NE(button, nullptr);
  }
  /// A sent share of files that exist.
  void addLocalFiles(int count) {
    for (int i = 0; i < count; ++i) {
      ZQViewerThumbnailItem& item = items.add("local" + std::to_string(i) + ".pdf", 10);
      replaceText(&item.downloadUrl, nullptr);
      item.filePath = g_strdup(
          file(testing::TempDir() + "zelqo-local" + std::to_string(i) + ".pdf", "%PDF").c_str());
    }
  }
  std::string file(const std::string& path, const std::string& content) {
    remove(path.c_str());
    std::ofstream(path) << content;
    _files.push_back(path);
    return path;
  }
  /// A file in the download folder; skips the test where there is none.
  bool hasDownloads() const { return access(ZQV_DOWNLOAD_DIR, W_OK) == 0; }
  std::string download(const std::string& name, const std::string& content = "%PDF") {
    return file(std::string(ZQV_DOWNLOAD_DIR "/") + name, content);
  }

  int page() const {
    int page = -1;
    elm_scroller_current_page_get(pager, &page, nullptr);
    return page;
  }
  bool isSettled() const {
    Eina_Bool isSnapping = EINA_FALSE;
    elm_scroller_page_snap_get(pager, &isSnapping, nullptr);
    return isSnapping;
  }
  bool waitForPage(int wanted) {
    return waitUntil([this, wanted] { return isSettled() && page() == wanted; });
  }
  /// In either direction: the page is found by what is on it.
  bool waitForFile(int file) {
    return waitUntil([this, file] {
      return isSettled() && isInTheMiddleOfItsGrid(items[file].gridItems[ZQV_VIEW_FULL_RECEIVER]);
    });
  }
  void turnTo(int wanted) {
    ASSERT_TRUE(waitUntil([this] { return isSettled(); }));
    // A drag may go anywhere; a programmed move goes one page at a time.
    elm_scroller_page_snap_set(pager, EINA_FALSE, EINA_FALSE);
    elm_scroller_page_show(pager, wanted, 0);
    ASSERT_TRUE(waitUntil([this, wanted] { return page() == wanted; }));
    ZQVFullView::_scrollCb(view, pager, nullptr);
    elm_scroller_page_snap_set(pager, EINA_TRUE, EINA_FALSE);
  }
  std::string buttonText() const { return textOf(button); }
  std::string iconFile() const {
    Evas_Object* layout = elm_object_item_part_content_get(view->getNaviItem(), "title_right_btn");
    Evas_Object* icon = layout ? elm_object_part_content_get(layout, "content") : nullptr;
    const char* path = nullptr;
    if (icon) elm_image_file_get(icon, &path, nullptr);
    return path ? path : "";
  }
  void tapButton() { ZQVFullView::fullViewerToolBtnCb(view, button, nullptr); }

  Watched<ZQVFullView>* view = nullptr;
  Evas_Object* pager = nullptr;
  Evas_Object* button = nullptr;
  bool isGone = false;

 private:
  std::vector<std::string> _files;
};

TEST_F(FullView, HasNoViewWithoutParentOrFile) {
  items.addCount(1);
  ZQVFullView alone(items.list(), ZQV_VIEW_FULL_RECEIVER, nullptr, nullptr);
  EXPECT_STREQ(alone.getClassName(), "ZQVFullView");
  EXPECT_EQ(alone.onCreateView(nullptr, &items[0]), nullptr);
  EXPECT_EQ(alone.onCreateView(TestApp::get().window(), nullptr), nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("parent is NULL", "viewParam is NULL"));
}

TEST_F(FullView, NumbersTheFilesByTheirPage) {
  items.addCount(3);
  items.addNothing();
  items.add("last.pdf", 1);
  items[0].index = 0;
  items[1].index = 4;
  items[2].index = 9;
  open(2);
  for (int i = 0; i < 4; ++i) {
    EXPECT_EQ(items[i].index, i);
    EXPECT_NE(items[i].gridItems[ZQV_VIEW_FULL_RECEIVER], nullptr);
  }
  EXPECT_EQ(elm_gengrid_items_count(pager), 4u);
}

TEST_F(FullView, BeginsWithTheTappedFile) {
  items.addCount(8);
  open(5);
  EXPECT_TRUE(waitForPage(5));
}

TEST_F(FullView, BeginsWithTheLastOfManyFiles) {
  items.addCount(5000);
  open(4999);
  EXPECT_TRUE(waitForPage(4999));
}

TEST_F(FullView, PaintsNoOtherPageFirst) {
  items.addCount(10);
  view = new Watched<ZQVFullView>(&isGone, items.list(), ZQV_VIEW_FULL_RECEIVER, "", "");
  PaintedPages painted(items);
  naviframe.push(view, &items[6], "fullview");
  pager = view->getEvasObj();
  ASSERT_TRUE(waitForPage(6));
  ASSERT_TRUE(waitUntil([&] { return !painted.pages().empty(); }));
  painted.stop();
  EXPECT_THAT(painted.pages(), ElementsAre(6));
}

TEST_F(FullView, BeginsWithTheTappedFileFromRightToLeft) {
  const FromRightToLeft mirrored;
  items.addCount(9);
  items[2].downloadStatus = ZQV_DOWNLOADED;
  open(3);
  ASSERT_TRUE(waitForFile(3));
  EXPECT_EQ(buttonText(), zqvText(kDownload));
  // A page to the right is the one before.
  int x = 0, y = 0, width = 0, height = 0;
  elm_scroller_region_get(pager, &x, &y, &width, &height);
  elm_scroller_page_snap_set(pager, EINA_FALSE, EINA_FALSE);
  elm_scroller_region_show(pager, x + width, y, width, height);
  elm_scroller_page_snap_set(pager, EINA_TRUE, EINA_FALSE);
  ASSERT_TRUE(waitForFile(2));
  ZQVFullView::_scrollCb(view, pager, nullptr);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
}

TEST_F(FullView, KeepsItsPageInEveryShapeFromRightToLeft) {
  const FromRightToLeft mirrored;
  items.addCount(9);
  open(2);
  ASSERT_TRUE(waitForFile(2));
  for (const int degrees : {90, 0}) {
    elm_win_rotation_with_resize_set(TestApp::get().window(), degrees);
    ASSERT_TRUE(waitUntil([this] { return !isSettled(); }));
    EXPECT_TRUE(waitForFile(2));
  }
}

TEST_F(FullView, KeepsItsPageWhenTheDirectionChanges) {
  items.addCount(9);
  open(6);
  ASSERT_TRUE(waitForFile(6));
  {
    const FromRightToLeft mirrored;
    view->update(kLanguageChanged);
    EXPECT_TRUE(waitForFile(6));
  }
  view->update(kLanguageChanged);
  EXPECT_TRUE(waitForFile(6));
}

TEST_F(FullView, MarksItsPagerWithItsKind) {
  items.addCount(1);
  open(0);
  EXPECT_EQ(evas_object_data_get(pager, "ViewType"), reinterpret_cast<void*>(4));
  EXPECT_EQ(evas_object_data_get(pager, "bindedObject"), button);
  EXPECT_EQ(evas_object_data_get(pager, "bindedObjectClickedCbData"), view);
}

TEST_F(FullView, LimitsASwipeToOnePage) {
  items.addCount(3);
  open(0);
  int limit = 0;
  elm_interface_scrollable_page_scroll_limit_get(pager, &limit, nullptr);
  EXPECT_EQ(limit, 1);
}

TEST_F(FullView, OffersToDownloadAReceivedFile) {
  items.addCount(2);
  items[1].downloadStatus = ZQV_REQUESTED;
  open(0);
  EXPECT_EQ(buttonText(), zqvText(kDownload));
  EXPECT_TRUE(isEnabled(button));
  EXPECT_EQ(iconFile(), "");
  turnTo(1);
  EXPECT_EQ(buttonText(), zqvText(kDownload));
  EXPECT_TRUE(isEnabled(button));
}

TEST_F(FullView, DisablesTheButtonOfAFileThatIsBeingDownloaded) {
  items.addCount(1);
  items[0].downloadStatus = ZQV_DOWNLOADING;
  open(0);
  EXPECT_EQ(buttonText(), zqvText(kDownload));
  EXPECT_FALSE(isEnabled(button));
  EXPECT_THAT(iconFile(), testing::StartsWith(ZQV_IMAGE_DIR "zq_ic_download_progress/55/"));
  EXPECT_THAT(log.traces(), Contains(testing::StartsWith("downloading icon:")));
}

TEST_F(FullView, OffersToOpenADownloadedFile) {
  items.addCount(1);
  items[0].downloadStatus = ZQV_DOWNLOADED;
  open(0);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
  EXPECT_TRUE(isEnabled(button));
  EXPECT_EQ(iconFile(), ZQV_IMAGE_DIR "zq_ic_downloaded.png");
  EXPECT_THAT(log.traces(), Contains(testing::StartsWith("downloaded icon:")));
}

TEST_F(FullView, FollowsTheFileOnScreen) {
  items.addCount(4);
  items[1].downloadStatus = ZQV_DOWNLOADED;
  items[2].downloadStatus = ZQV_DOWNLOADING;
  open(0);
  turnTo(1);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
  EXPECT_EQ(iconFile(), ZQV_IMAGE_DIR "zq_ic_downloaded.png");
  turnTo(2);
  EXPECT_FALSE(isEnabled(button));
  turnTo(3);
  EXPECT_EQ(buttonText(), zqvText(kDownload));
  EXPECT_TRUE(isEnabled(button));
  EXPECT_EQ(iconFile(), "");
}

TEST_F(FullView, RecognisesADownloadedFileByItsPreference) {
  if (!hasDownloads()) GTEST_SKIP() << "no download folder here";
  items.add("zelqo-test-a.pdf", 1);
  items.add("zelqo-test-b.pdf", 1);
  download("zelqo-test-a.pdf");
  phone.preferences[items[0].downloadUrl] = items[0].downloadUrl;
  phone.preferences[items[1].downloadUrl] = items[1].downloadUrl;
  open(0);
  EXPECT_EQ(items[0].downloadStatus, ZQV_DOWNLOADED);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
  open(1);
  EXPECT_EQ(items[1].downloadStatus, ZQV_NOT_DOWNLOADED) << "its file is not there";
}

TEST_F(FullView, DoesNotTakeAFileOfTheSameNameForADownloadedOne) {
  if (!hasDownloads()) GTEST_SKIP() << "no download folder here";
  items.add("zelqo-test-a.pdf", 1);
  download("zelqo-test-a.pdf");
  phone.preferences[items[0].downloadUrl] = "something else";
  open(0);
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(FullView, NeverDownloadsASentFile) {
  addLocalFiles(1);
  open(0, ZQV_VIEW_FULL_SENDER);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
  EXPECT_TRUE(isEnabled(button));
  EXPECT_EQ(elm_object_item_part_content_get(view->getNaviItem(), "title_right_btn"), nullptr);
}

TEST_F(FullView, DisablesTheButtonForASentFileThatIsMissingOrTheServicesOwn) {
  addLocalFiles(3);
  items[1].noThumbnail = true;
  replaceText(&items[2].filePath, "/opt/usr/apps/com.orlant.zelqo/shared/data/local2.pdf");
  open(0, ZQV_VIEW_FULL_SENDER);
  turnTo(1);
  EXPECT_FALSE(isEnabled(button));
  turnTo(0);
  EXPECT_TRUE(isEnabled(button));
  turnTo(2);
  EXPECT_FALSE(isEnabled(button));
  tapButton();
  EXPECT_THAT(phone.launches, IsEmpty());
}

TEST_F(FullView, LogsASentFileWithoutAPath) {
  addLocalFiles(1);
  replaceText(&items[0].filePath, nullptr);
  open(0, ZQV_VIEW_FULL_SENDER);
  EXPECT_THAT(log.errors(), Contains("_curItem->filePath is NULL"));
}

TEST_F(FullView, DownloadsTheFileOnScreenOnly) {
  items.addCount(3);
  open(1);
  tapButton();
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("name"), ElementsAre("file1.pdf"));
  EXPECT_THAT(phone.launches[0].extra("sender"), ElementsAre("Minji"));
  EXPECT_THAT(phone.launches[0].extra("token"), ElementsAre("token-1"));
  EXPECT_THAT(phone.usageOf("ZQ54"), ElementsAre("Document"));
  EXPECT_THAT(phone.usageOf("ZQ55"), ElementsAre("0_100MB"));
  EXPECT_THAT(phone.usageOf("ZQ51"), IsEmpty());
  EXPECT_EQ(items[1].downloadStatus, ZQV_REQUESTED);
  EXPECT_FALSE(items[1].checked);

  turnTo(2);
  tapButton();
  ASSERT_EQ(phone.launches.size(), 2u);
  EXPECT_THAT(phone.launches[1].extra("name"), ElementsAre("file2.pdf"));
}

TEST_F(FullView, NamesTheNewSenderAfterItChanged) {
  items.addCount(1);
  open(0);
  view->setName("Jiho");
  tapButton();
  EXPECT_THAT(phone.launches[0].extra("sender"), ElementsAre("Jiho"));
}

TEST_F(FullView, LeavesNoMarkWhenThereIsNoConnection) {
  items.addCount(2);
  open(0);
  phone.network = CONNECTION_TYPE_DISCONNECTED;
  tapButton();
  EXPECT_THAT(phone.statusMessages, ElementsAre(zqvText(kNoNetwork)));
  phone.network = CONNECTION_TYPE_CELLULAR;
  turnTo(1);
  tapButton();
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("name"), ElementsAre("file1.pdf"));
}

TEST_F(FullView, HandsOverNothingForAFileWithoutAnAddress) {
  items.addCount(2);
  replaceText(&items[0].downloadUrl, nullptr);
  replaceText(&items[1].downloadUrl, nullptr);
  open(1);
  tapButton();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(log.errors(), Contains("selected count error"));
}

TEST_F(FullView, AsksAboveTheLimitOnly) {
  items.add("a.mp4", kLimit);
  items.add("b.mp4", kLimit + 1);
  open(0);
  tapButton();
  EXPECT_EQ(phone.launches.size(), 1u);
  EXPECT_EQ(popup(), nullptr);
  turnTo(1);
  tapButton();
  EXPECT_EQ(phone.launches.size(), 1u);
  EXPECT_TRUE(waitForPopup());
}

TEST_F(FullView, HandsOverFromThePopupAndClosesItOnly) {
  items.add("a.mp4", kLimit + 1);
  open(0);
  tapButton();
  ASSERT_TRUE(waitForPopup());
  phone.network = CONNECTION_TYPE_DISCONNECTED;
  click(popupButton(2));
  EXPECT_THAT(phone.statusMessages, ElementsAre(zqvText(kNoNetwork)));
  EXPECT_NE(popup(), nullptr) << "it stays open after a message";

  Evas_Object* check =
      elm_object_part_content_get(elm_object_content_get(popup()), "elm.swallow.check");
  elm_check_state_set(check, EINA_TRUE);
  evas_object_smart_callback_call(check, "changed", nullptr);
  phone.network = CONNECTION_TYPE_WIFI;
  click(popupButton(2));
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("wifi_check"), ElementsAre("1"));
  EXPECT_THAT(phone.launches[0].extra("name"), ElementsAre("a.mp4"));
  EXPECT_TRUE(waitForNoPopup());
  EXPECT_TRUE(isTop("ZQVFullView"));
  EXPECT_FALSE(items[0].checked);
}

TEST_F(FullView, CarriesNoFileWhosePopupWasCancelled) {
  items.add("a.mp4", kLimit + 1);
  items.add("b.pdf", 1);
  open(0);
  tapButton();
  ASSERT_TRUE(waitForPopup());
  click(popupButton(1));
  ASSERT_TRUE(waitForNoPopup());
  turnTo(1);
  tapButton();
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("name"), ElementsAre("b.pdf"));
}

TEST_F(FullView, OpensASentFileInItsProgram) {
  addLocalFiles(1);
  open(0, ZQV_VIEW_FULL_SENDER);
  tapButton();
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_EQ(phone.launches[0].uri, items[0].filePath);
  EXPECT_EQ(phone.launches[0].operation, APP_CONTROL_OPERATION_VIEW);
  EXPECT_EQ(phone.launches[0].mode, APP_CONTROL_LAUNCH_MODE_GROUP);
  EXPECT_EQ(phone.launches[0].mime, "");
  EXPECT_EQ(phone.launches[0].appId, "");
  EXPECT_NE(phone.launches[0].reply, nullptr);
  EXPECT_THAT(phone.usageOf("ZQ56"), ElementsAre("Document"));
  EXPECT_EQ(phone.openRequests, 0);
}

TEST_F(FullView, SaysWhenNoProgramOpensTheFile) {
  addLocalFiles(1);
  open(0, ZQV_VIEW_FULL_SENDER);
  phone.launchErrors.send = APP_CONTROL_ERROR_APP_NOT_FOUND;
  tapButton();
  EXPECT_THAT(phone.statusMessages, ElementsAre(zqvText(kNoProgram)));
  EXPECT_THAT(phone.usageOf("ZQ56"), ElementsAre("Document")) << "recorded whatever happened";
}

TEST_F(FullView, RecordsNothingWhenTheRequestCannotBeMade) {
  addLocalFiles(1);
  open(0, ZQV_VIEW_FULL_SENDER);
  phone.launchErrors.create = APP_CONTROL_ERROR_OUT_OF_MEMORY;
  tapButton();
  EXPECT_THAT(phone.statusMessages, IsEmpty());
  EXPECT_THAT(phone.usage, IsEmpty());
}

TEST_F(FullView, GivesNoProgramToTheSystem) {
  addLocalFiles(1);
  chmod(items[0].filePath, 0755);
  open(0, ZQV_VIEW_FULL_SENDER);
  tapButton();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.statusMessages, ElementsAre(zqvText(kNoProgram)));
}

TEST_F(FullView, GivesNoFolderToTheSystem) {
  addLocalFiles(1);
  replaceText(&items[0].filePath, testing::TempDir().c_str());
  open(0, ZQV_VIEW_FULL_SENDER);
  tapButton();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.statusMessages, ElementsAre(zqvText(kNoProgram)));
}

TEST_F(FullView, OpensADownloadedFileFromTheDownloadFolder) {
  if (!hasDownloads()) GTEST_SKIP() << "no download folder here";
  items.add("zelqo-test-a.pdf", 1);
  const std::string path = download("zelqo-test-a.pdf");
  items[0].downloadStatus = ZQV_DOWNLOADED;
  open(0);
  tapButton();
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_EQ(phone.launches[0].uri, path);
}

TEST_F(FullView, OpensNoLinkInTheDownloadFolder) {
  if (!hasDownloads()) GTEST_SKIP() << "no download folder here";
  items.add("zelqo-test-a.pdf", 1);
  const std::string path = download("zelqo-test-a.pdf");
  remove(path.c_str());
  ASSERT_EQ(symlink("/etc/passwd", path.c_str()), 0);
  items[0].downloadStatus = ZQV_DOWNLOADED;
  open(0);
  tapButton();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.statusMessages, ElementsAre(zqvText(kNoProgram)));
}

TEST_F(FullView, OffersToDownloadAMissingFileAgain) {
  items.add("zelqo-test-missing.pdf", 1);
  items[0].downloadStatus = ZQV_DOWNLOADED;
  open(0);
  tapButton();
  ASSERT_TRUE(waitForPopup());
  EXPECT_EQ(textOf(popup(), "title,text"), zqvText("IDS_RSH_HEADER_UNABLE_TO_OPEN_FILE_ABB"));
  EXPECT_THAT(phone.launches, IsEmpty());
  click(popupButton(2));
  EXPECT_TRUE(waitForNoPopup());
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_EQ(phone.launches[0].appId, "com.orlant.myfile-download-manager");
  EXPECT_FALSE(items[0].checked);
}

TEST_F(FullView, ClosesTheUnableToOpenPopupEvenWhenTheDownloadIsRefused) {
  items.add("zelqo-test-missing.pdf", 1);
  items[0].downloadStatus = ZQV_DOWNLOADED;
  open(0);
  tapButton();
  ASSERT_TRUE(waitForPopup());
  phone.network = CONNECTION_TYPE_DISCONNECTED;
  click(popupButton(2));
  EXPECT_TRUE(waitForNoPopup());
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.statusMessages, ElementsAre(zqvText(kNoNetwork)));
}

TEST_F(FullView, AsksForALargeMissingFileWhileTheOtherPopupCloses) {
  items.add("zelqo-test-missing.pdf", kLimit + 1);
  items[0].downloadStatus = ZQV_DOWNLOADED;
  open(0);
  tapButton();
  ASSERT_TRUE(waitForPopup());
  click(popupButton(2));
  ASSERT_TRUE(waitUntil([] {
    return popup() && textOf(popup(), "title,text") == zqvText("IDS_RSH_HEADER_DOWNLOAD_FILES");
  }));
  click(popupButton(2));
  EXPECT_EQ(phone.launches.size(), 1u);
}

TEST_F(FullView, DoesNothingForAFileWithoutAPicture) {
  addLocalFiles(1);
  items[0].noThumbnail = true;
  open(0, ZQV_VIEW_FULL_SENDER);
  tapButton();
  EXPECT_THAT(phone.launches, IsEmpty());
}

TEST_F(FullView, DoesNothingWithoutAButtonText) {
  items.addCount(1);
  open(0);
  elm_object_domain_translatable_text_set(button, ZQV_TEXT_DOMAIN, nullptr);
  elm_object_text_set(button, "");
  tapButton();
  EXPECT_THAT(phone.launches, IsEmpty());
}

TEST_F(FullView, FollowsTheDownloadSignals) {
  items.addCount(2);
  open(0);
  signalDownload("file_downloading", items[0].downloadUrl);
  EXPECT_TRUE(waitUntil([this] { return items[0].downloadStatus == ZQV_DOWNLOADING; }));
  EXPECT_FALSE(isEnabled(button));
  signalDownload("file_downloaded", items[0].downloadUrl);
  EXPECT_TRUE(waitUntil([this] { return items[0].downloadStatus == ZQV_DOWNLOADED; }));
  EXPECT_EQ(buttonText(), zqvText(kOpen));
  EXPECT_TRUE(isEnabled(button));
}

TEST_F(FullView, KeepsTheButtonWhenASignalIsAboutAnotherFile) {
  items.addCount(2);
  open(0);
  signalDownload("file_downloading", "http://elsewhere/1");
  signalDownload("file_downloading", items[1].downloadUrl);
  EXPECT_TRUE(waitUntil([this] { return items[1].downloadStatus == ZQV_DOWNLOADING; }));
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
  EXPECT_TRUE(isEnabled(button));
  turnTo(1);
  EXPECT_FALSE(isEnabled(button));
}

TEST_F(FullView, IsRightEvenWhenThePageBelowHasTakenTheSignalFirst) {
  items.addCount(1);
  open(0);
  items[0].downloadStatus = ZQV_DOWNLOADED;
  signalDownload("file_downloaded", items[0].downloadUrl);
  EXPECT_TRUE(waitUntil([this] { return buttonText() == zqvText(kOpen); }));
}

TEST_F(FullView, HearsNoSignalsAfterItIsGone) {
  items.addCount(1);
  open(0);
  naviframe.pop();
  ASSERT_TRUE(waitUntil([this] { return isGone; }));
  signalDownload("file_downloaded", items[0].downloadUrl);
  GDBusConnection* bus = g_bus_get_sync(G_BUS_TYPE_SYSTEM, nullptr, nullptr);
  g_dbus_connection_flush_sync(bus, nullptr, nullptr);
  g_object_unref(bus);
  while (g_main_context_iteration(nullptr, FALSE)) {
  }
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(FullView, KeepsItsPageWhenItGetsAnotherSize) {
  items.addCount(10);
  open(6);
  ASSERT_TRUE(waitForPage(6));
  Evas_Object* window = TestApp::get().window();
  for (const int degrees : {90, 0, 270, 0}) {
    elm_win_rotation_with_resize_set(window, degrees);
    EXPECT_TRUE(waitForPage(6)) << degrees;
    int width = 0;
    int cell = 0;
    evas_object_geometry_get(pager, nullptr, nullptr, &width, nullptr);
    elm_gengrid_item_size_get(pager, &cell, nullptr);
    EXPECT_EQ(cell, width);
  }
  items[6].downloadStatus = ZQV_DOWNLOADED;
  signalDownload("file_downloaded", items[6].downloadUrl);
  EXPECT_TRUE(waitUntil([this] { return buttonText() == zqvText(kOpen); }))
      << "the current file is still the one on screen";
}

TEST_F(FullView, SetsTheTextOfTheFileItWasOpenedWithWhenTheLanguageChanges) {
  items.addCount(2);
  items[1].downloadStatus = ZQV_DOWNLOADED;
  open(0);
  turnTo(1);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
  view->update(14);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
  view->update(kLanguageChanged);
  EXPECT_EQ(buttonText(), zqvText(kDownload)) << "by the file it was opened with";
}

TEST_F(FullView, KeepsOpenForASentShareWhenTheLanguageChanges) {
  addLocalFiles(1);
  open(0, ZQV_VIEW_FULL_SENDER);
  view->update(kLanguageChanged);
  EXPECT_EQ(buttonText(), zqvText(kOpen));
}

TEST_F(FullView, LogsAMissingButtonWhenTheLanguageChanges) {
  items.addCount(1);
  open(0);
  evas_object_del(elm_object_item_part_content_unset(view->getNaviItem(), "toolbar"));
  view->update(kLanguageChanged);
  EXPECT_THAT(log.errors(), Contains("toolbar part object is null!"));
}

TEST_F(FullView, ForwardsALanguageChangeToItsPopups) {
  items.add("zelqo-test-missing.mp4", kLimit + 1);
  open(0);
  tapButton();
  ASSERT_TRUE(waitForPopup());
  elm_object_text_set(popupButton(1), "old");
  view->update(kLanguageChanged);
  EXPECT_EQ(textOf(popupButton(1)), zqvText("IDS_RSH_BUTTON_CANCEL_ABB2"));
}

TEST_F(FullView, LeavesWithItsBackButton) {
  items.addCount(2);
  open(0);
  Evas_Object* back = elm_object_item_part_content_get(view->getNaviItem(), "prev_btn");
  ASSERT_NE(back, nullptr);
  click(back);
  EXPECT_EQ(items[0].gridItems[ZQV_VIEW_FULL_RECEIVER], nullptr);
  EXPECT_TRUE(waitUntil([this] { return isGone; }));
  EXPECT_TRUE(isTop("BlankPage"));
}

TEST_F(FullView, ClosesItsPopupsWithAllPages) {
  items.add("zelqo-test-missing.mp4", kLimit + 1);
  open(0);
  tapButton();
  ASSERT_TRUE(waitForPopup());
  naviframe.destroyAllViewControllers();
  EXPECT_TRUE(isGone);
  EXPECT_TRUE(waitForNoPopup());
  EXPECT_EQ(items[0].gridItems[ZQV_VIEW_FULL_RECEIVER], nullptr);
  EXPECT_FALSE(items[0].checked);
}

TEST_F(FullView, LogsHandlersThatLackTheirData) {
  ZQVFullView::_realizedCb(nullptr, nullptr, nullptr);
  ZQVFullView::_scrollCb(nullptr, nullptr, nullptr);
  ZQVFullView::_rotateCb(nullptr, nullptr, nullptr);
  ZQVFullView::_backButtonCb(nullptr, nullptr, nullptr);
  ZQVFullView::fullViewerToolBtnCb(nullptr, nullptr, nullptr);
  EXPECT_FALSE(ZQVFullView::_delayerSetSize(nullptr));
  ZQVFullView::_downloadRequest(nullptr, nullptr);
  EXPECT_THAT(log.errors(), testing::Each("data is NULL"));
  EXPECT_EQ(log.errors().size(), 7u);
}

TEST_F(FullView, LogsAMissingNaviframeItem) {
  items.addCount(1);
  ZQVFullView alone(items.list(), ZQV_VIEW_FULL_RECEIVER, nullptr, nullptr);
  alone.onPushed(nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("naviItem is NULL"));
}

TEST_F(FullView, DoesNothingWhileThereIsNoFileOnScreen) {
  items.addCount(1);
  ZQVFullView alone(items.list(), ZQV_VIEW_FULL_RECEIVER, nullptr, nullptr);
  ZQVFullView::fullViewerToolBtnCb(&alone, nullptr, nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("_curItem is NULL"));
  EXPECT_THAT(phone.launches, IsEmpty());
}
