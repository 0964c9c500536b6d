#include <gio/gio.h>
#include <system_settings.h>

#include "PageTest.h"
#include "ZQVReceiverView.h"
#include "ZQVText.h"

namespace {

constexpr uint64_t kExpiry = 1700000000000;  // 14 November 2023

class ReceiverView : public PageTest {
 protected:
  void show(bool isSingleShare = false, const char* sender = "Anna", uint64_t size = 3 << 20) {
    view = new ZQVReceiverView(items.list(), isSingleShare, size, kExpiry, sender, "token");
    naviframe.push(view);
  }
  Evas_Object* part(const char* name) const {
    return elm_object_part_content_get(view->getEvasObj(), name);
  }
  Evas_Object* grid() const { return part("elm.swallow.gengrid.layout"); }
  unsigned int cells() const { return elm_gengrid_items_count(grid()); }
  std::string summary() const { return textOf(part("elm.swallow.label.text")); }
  static std::string markup(const std::string& text) {
    return "<font=Sans text_class=T024><font_size=24><color=#123456><align=left>" + text +
           "</align></color></font_size></font>";
  }
  bool isDownloadEnabled() const { return !elm_object_disabled_get(toolbarButton()); }

  ZQVReceiverView* view = nullptr;
};

TEST_F(ReceiverView, SaysWhoSentHowMuchUntilWhen) {
  items.addCount(2);
  show();
  EXPECT_STREQ(view->getClassName(), "ZQVReceiverView");
  EXPECT_EQ(title(), "From Anna");
  EXPECT_EQ(summary(), markup("2 files (3.00 MB)<br>until 14/11/2023"));
  EXPECT_EQ(textOf(toolbarButton()), "Download");
  EXPECT_TRUE(errors().empty());
}

TEST_F(ReceiverView, CountsOneFileInItsOwnWords) {
  items.addCount(1);
  show(true, "Anna", 1536);
  EXPECT_EQ(summary(), markup("1 file (1.50 KB)<br>until 14/11/2023<br><br>later this"));
}

TEST_F(ReceiverView, HintsAtLaterDownloadsOfASingleShare) {
  items.addCount(2);
  show(true);
  EXPECT_EQ(summary(), markup("2 files (3.00 MB)<br>until 14/11/2023<br><br>later these"));
}

TEST_F(ReceiverView, OfNoFilesUsesTheWordsForSeveralAndTheHintForOne) {
  show(true);
  EXPECT_EQ(summary(), markup("0 files (3.00 MB)<br>until 14/11/2023<br><br>later this"));
  EXPECT_EQ(cells(), 0u);
  EXPECT_FALSE(isDownloadEnabled());
}

TEST_F(ReceiverView, CutsTheSizeToNineCharacters) {
  show(false, "Anna", 12345678ULL << 20);
  EXPECT_NE(summary().find("(12345678. MB)"), std::string::npos);
}

TEST_F(ReceiverView, ShowsTheSendersNameAsItIs) {
  show(false, "<b>&");
  EXPECT_EQ(title(), "From &lt;b&gt;&amp;");
}

TEST_F(ReceiverView, TellsScreenReadersTheSendersName) {
  show(false, "<b>&");
  EXPECT_STREQ(efl_access_object_i18n_name_get(topItem()), "From <b>&");
  view->setName("Berta");
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  EXPECT_STREQ(efl_access_object_i18n_name_get(topItem()), "From Berta");
}

TEST_F(ReceiverView, CutsAVeryLongNameWithinItsTitle) {
  show(false, std::string(2000, '&').c_str());
  EXPECT_LE(title().size(), 511u);
  EXPECT_EQ(title().substr(title().size() - 5), "&amp;");
}

TEST_F(ReceiverView, TakesNoTextForAnEmptyOne) {
  show(false, nullptr);
  EXPECT_EQ(title(), "From ");
}

TEST_F(ReceiverView, SurvivesAShareWithoutAnExpiry) {
  view = new ZQVReceiverView(nullptr, false, 0, 0, "A", nullptr);
  naviframe.push(view);
  EXPECT_NE(summary().find("until </align>"), std::string::npos);
}

TEST_F(ReceiverView, NeedsAParent) {
  ZQVReceiverView alone(nullptr, false, 0, 0, nullptr, nullptr);
  EXPECT_EQ(alone.onCreateView(nullptr, nullptr), nullptr);
  EXPECT_EQ(errors(), Errors({"parent is NULL"}));
}

TEST_F(ReceiverView, ShowsACellPerFile) {
  items.addCount(19);
  show();
  EXPECT_EQ(cells(), 19u);
  int width = 0, height = 0;
  elm_gengrid_item_size_get(grid(), &width, &height);
  EXPECT_EQ(width, height);
  for (size_t i = 0; i < items.size(); ++i) {
    Elm_Object_Item* cell = items[i].gridItems[ZQV_VIEW_RECEIVER];
    ASSERT_NE(cell, nullptr);
    EXPECT_EQ(elm_object_item_data_get(cell), &items[i]);
    EXPECT_STREQ(efl_access_object_i18n_name_get(cell),
                 (items[i].fileName + std::string(", 100.0B, PDF, not downloaded")).c_str());
  }
}

TEST_F(ReceiverView, FillsALongListInBatches) {
  items.addCount(20);
  show();
  EXPECT_EQ(cells(), 0u);
  FakeClock::advance(0.01);
  EXPECT_EQ(cells(), 11u);
  FakeClock::advance(0.01);
  EXPECT_EQ(cells(), 20u);
  EXPECT_EQ(FakeClock::running(), 0);
}

TEST_F(ReceiverView, StopsFillingWhenItGoes) {
  items.addCount(50);
  show();
  naviframe.destroyAllViewControllers();
  EXPECT_EQ(FakeClock::running(), 0);
}

TEST_F(ReceiverView, TakesItsCellsOffTheFilesWhenItGoes) {
  items.addCount(3);
  show();
  naviframe.destroyAllViewControllers();
  for (size_t i = 0; i < 3; ++i) EXPECT_EQ(items[i].gridItems[ZQV_VIEW_RECEIVER], nullptr);
}

TEST_F(ReceiverView, TakesItsCellsOffTheFilesWhenItIsPopped) {
  items.addCount(3);
  show();
  EXPECT_TRUE(view->onPop());
  for (size_t i = 0; i < 3; ++i) EXPECT_EQ(items[i].gridItems[ZQV_VIEW_RECEIVER], nullptr);
}

class GridKind : public ZQVReceiverView {
 public:
  GridKind(int* resets) : ZQVReceiverView(nullptr, false, 0, 0, "", ""), _resets(resets) {}
  void resetViewType(Evas_Object* grid) override {
    ++*_resets;
    ZQVReceiverView::resetViewType(grid);
    EXPECT_EQ(evas_object_data_get(grid, "ViewType"), nullptr);
  }

 private:
  int* _resets;
};

TEST_F(ReceiverView, ResetsTheKindOfItsGridWhenThatGoes) {
  int resets = 0;
  naviframe.push(new GridKind(&resets));
  naviframe.destroyAllViewControllers();
  EXPECT_EQ(resets, 1);
}

TEST_F(ReceiverView, LowersTheWindowAfterASingleShare) {
  show(true);
  naviframe.destroyAllViewControllers();
  EXPECT_EQ(platform().lowered, 1);
  show(false);
  naviframe.destroyAllViewControllers();
  EXPECT_EQ(platform().lowered, 1);
}

TEST_F(ReceiverView, OpensTheTappedFileInTheFullView) {
  items.addCount(2);
  show();
  ZQVReceiverView::_gridItemCb(view, grid(), items[1].gridItems[ZQV_VIEW_RECEIVER]);
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView", "ZQVFullView"}));
  EXPECT_NE(items[1].gridItems[ZQV_VIEW_FULL_RECEIVER], nullptr);
}

TEST_F(ReceiverView, OpensTheSelectPageWithANetwork) {
  items.addCount(2);
  show();
  click(toolbarButton());
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView", "ZQVSelectView"}));
}

TEST_F(ReceiverView, OpensNothingWithoutANetwork) {
  items.addCount(2);
  platform().network = 0;
  show();
  click(toolbarButton());
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
  EXPECT_EQ(platform().messages,
            Errors({zqvText(
                "IDS_MF_POP_MOBILE_DATA_IS_TURNED_OFF_CONNECT_TO_A_WI_FI_NETWORK_INSTEAD_MSG")}));
  EXPECT_EQ(errors(), Errors({"No network"}));
}

TEST_F(ReceiverView, LogsCallbacksWithoutArguments) {
  items.addCount(1);
  show();
  ZQVReceiverView::_gridItemCb(view, grid(), nullptr);
  ZQVReceiverView::_gridItemCb(nullptr, grid(), items[0].gridItems[ZQV_VIEW_RECEIVER]);
  ZQVReceiverView::_downloadBtnCb(nullptr, nullptr, nullptr);
  ZQVReceiverView::_backButtonCb(nullptr, nullptr, nullptr);
  ZQVReceiverView::_rotateCb(nullptr, window, nullptr);
  ZQVReceiverView::_rotateCb(view, nullptr, nullptr);
  EXPECT_EQ(errors(), Errors({"event_info is NULL", "data is NULL", "data is NULL", "data is NULL",
                              "data || !obj", "data || !obj"}));
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
}

TEST_F(ReceiverView, KeepsDownloadEnabledWhileAnyFileIsNotDownloading) {
  items.addCount(3);
  items[0].downloadStatus = ZQV_DOWNLOADING;
  items[1].downloadStatus = ZQV_DOWNLOADING;
  items[2].downloadStatus = ZQV_DOWNLOADED;
  show();
  EXPECT_TRUE(isDownloadEnabled());
  items[2].downloadStatus = ZQV_DOWNLOADING;
  view->onBecomeTop();
  EXPECT_FALSE(isDownloadEnabled());
  items[2].downloadStatus = ZQV_REQUESTED;
  view->onBecomeTop();
  EXPECT_FALSE(isDownloadEnabled());
  items[0].downloadStatus = ZQV_NOT_DOWNLOADED;
  view->onBecomeTop();
  EXPECT_TRUE(isDownloadEnabled());
}

TEST_F(ReceiverView, SaysTheStateOfAFileAgainWhenItBecomesTheTop) {
  items.addCount(1);
  show();
  items[0].downloadStatus = ZQV_DOWNLOADED;
  view->onBecomeTop();
  EXPECT_STREQ(efl_access_object_i18n_name_get(items[0].gridItems[ZQV_VIEW_RECEIVER]),
               "file0.pdf, 100.0B, PDF, downloaded");
}

TEST_F(ReceiverView, ShowsItsTextsAnewWhenTheLanguageChanges) {
  items.addCount(2);
  show();
  view->setName("Berta");
  view->update(SYSTEM_SETTINGS_KEY_TIME_CHANGED);
  EXPECT_EQ(title(), "From Anna");
  platform().regionFormat = "en_US.UTF-8";
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  EXPECT_EQ(title(), "From Berta");
  EXPECT_EQ(summary(), markup("2 files (3.00 MB)<br>until 11/14/2023"));
  EXPECT_EQ(textOf(toolbarButton()), "Download");
}

TEST_F(ReceiverView, LogsAMissingButtonWhenTheLanguageChanges) {
  show();
  evas_object_del(elm_object_item_part_content_unset(topItem(), "toolbar"));
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  EXPECT_EQ(errors(), Errors({"toolbar part object is null!"}));
}

TEST_F(ReceiverView, FitsItsCellsToARotatedWindow) {
  items.addCount(1);
  show();
  elm_gengrid_item_size_set(grid(), 1, 1);
  evas_object_smart_callback_call(window, "rotation,changed", nullptr);
  int side = 0;
  elm_gengrid_item_size_get(grid(), &side, nullptr);
  EXPECT_NE(side, 1);
}

/// The download application at the other end of the system bus.
class DownloadSignals : public ReceiverView {
 protected:
  DownloadSignals() {
    _bus = g_dbus_connection_new_for_address_sync(
        getenv("DBUS_SYSTEM_BUS_ADDRESS"),
        static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                          G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION),
        nullptr, nullptr, nullptr);
  }
  ~DownloadSignals() override { g_object_unref(_bus); }

  void emit(const char* member, GVariant* body) {
    awaitSubscription();
    g_dbus_connection_emit_signal(_bus, nullptr, "/com/orlant/remoteshare",
                                  "org.tizen.call.remote.share", member, body, nullptr);
    g_dbus_connection_flush_sync(_bus, nullptr, nullptr);
  }
  void emit(const char* member, const char* url) { emit(member, g_variant_new("(s)", url)); }
  bool waitForStatus(size_t file, int status) {
    return waitUntil([&] { return items[file].downloadStatus == status; });
  }
  Evas_Object* content(size_t file) {
    return elm_object_item_part_content_get(items[file].gridItems[ZQV_VIEW_RECEIVER],
                                            "elm.swallow.icon");
  }
  /// The picture that tells the state of the download, null without one.
  Evas_Object* mark(size_t file) {
    return content(file) ? elm_object_part_content_get(content(file), "downstatus") : nullptr;
  }
  bool waitForMark(size_t file) {
    return waitUntil([&] { return mark(file) != nullptr; });
  }

 private:
  /// The page subscribes by a connection of its own; the bus answers in the order of the questions.
  static void awaitSubscription() {
    GDBusConnection* bus = g_bus_get_sync(G_BUS_TYPE_SYSTEM, nullptr, nullptr);
    GVariant* id = g_dbus_connection_call_sync(bus, "org.freedesktop.DBus", "/org/freedesktop/DBus",
                                               "org.freedesktop.DBus", "GetId", nullptr, nullptr,
                                               G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr);
    if (id) g_variant_unref(id);
    g_object_unref(bus);
  }

  GDBusConnection* _bus;
};

TEST_F(DownloadSignals, FollowADownloadInItsCell) {
  items.addCount(2);
  show();
  emit("file_downloading", items[1].downloadUrl);
  EXPECT_TRUE(waitForStatus(1, ZQV_DOWNLOADING));
  EXPECT_STREQ(efl_access_object_i18n_name_get(items[1].gridItems[ZQV_VIEW_RECEIVER]),
               "file1.pdf, 100.0B, PDF, downloading");
  emit("file_downloaded", items[1].downloadUrl);
  EXPECT_TRUE(waitForStatus(1, ZQV_DOWNLOADED));
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadSignals, DrawTheStateIntoTheirCell) {
  items.addCount(2);
  show();
  ASSERT_TRUE(waitUntil([this] { return content(1) != nullptr; }));
  emit("file_downloading", items[1].downloadUrl);
  EXPECT_TRUE(waitForMark(1));
  EXPECT_EQ(mark(0), nullptr);
}

TEST_F(DownloadSignals, AreHeardOfTwoMembersOnly) {
  items.addCount(2);
  show();
  emit("file_downloading", items[0].downloadUrl);
  EXPECT_TRUE(waitForStatus(0, ZQV_DOWNLOADING));
  for (const char* member : {"file_failed", "file_deleted", "anything"}) {
    emit(member, items[0].downloadUrl);
  }
  emit("file_downloaded", items[1].downloadUrl);
  EXPECT_TRUE(waitForStatus(1, ZQV_DOWNLOADED));
  EXPECT_EQ(items[0].downloadStatus, ZQV_DOWNLOADING);
}

TEST_F(DownloadSignals, DisableTheButtonWhileEverythingIsOnItsWay) {
  items.addCount(2);
  show();
  emit("file_downloading", items[0].downloadUrl);
  emit("file_downloading", items[1].downloadUrl);
  EXPECT_TRUE(waitUntil([&] { return !isDownloadEnabled(); }));
  emit("file_downloaded", items[0].downloadUrl);
  EXPECT_TRUE(waitUntil([&] { return isDownloadEnabled(); }));
}

TEST_F(DownloadSignals, ForAnUnknownFileStillLookAtTheButton) {
  items.addCount(1);
  show();
  elm_object_disabled_set(toolbarButton(), EINA_TRUE);
  emit("file_downloading", "http://elsewhere");
  EXPECT_TRUE(waitUntil([&] { return isDownloadEnabled(); }));
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadSignals, ChangeTheFirstFileOfThatAddress) {
  items.addCount(2);
  replaceText(&items[1].downloadUrl, items[0].downloadUrl);
  show();
  emit("file_downloaded", items[0].downloadUrl);
  EXPECT_TRUE(waitForStatus(0, ZQV_DOWNLOADED));
  EXPECT_EQ(items[1].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadSignals, PassFilesWithoutAnAddress) {
  items.addCount(2);
  replaceText(&items[0].downloadUrl, nullptr);
  show();
  emit("file_downloaded", items[1].downloadUrl);
  EXPECT_TRUE(waitForStatus(1, ZQV_DOWNLOADED));
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadSignals, OfAnotherTypeAreLoggedAndIgnored) {
  items.addCount(1);
  show();
  emit("file_downloaded", g_variant_new("(u)", 7));
  emit("file_downloaded", g_variant_new("(ss)", items[0].downloadUrl, "x"));
  emit("file_downloaded", static_cast<GVariant*>(nullptr));
  EXPECT_TRUE(waitUntil([] { return errors().size() >= 3; }));
  EXPECT_EQ(errors(), Errors({"file_downloaded with a body of type (u) is ignored",
                              "file_downloaded with a body of type (ss) is ignored",
                              "file_downloaded with a body of type () is ignored"}));
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadSignals, MeanNotDownloadedUnlessTheirNameSaysMore) {
  EXPECT_EQ(ZQVDownloadSignals::statusOf("file_downloading"), 2);
  EXPECT_EQ(ZQVDownloadSignals::statusOf("file_downloaded"), 3);
  EXPECT_EQ(ZQVDownloadSignals::statusOf("file_deleted"), 0);
  EXPECT_EQ(ZQVDownloadSignals::statusOf(nullptr), 0);
}

TEST_F(DownloadSignals, InTheThousandsLeaveThePageUsable) {
  items.addCount(100);
  show();
  FakeClock::advance(1);
  for (int i = 0; i < 10000; ++i) {
    const std::string url = "http://elsewhere/" + std::to_string(i);
    emit("file_downloading", i % 2 ? items[static_cast<size_t>(i) % 100].downloadUrl : url.c_str());
  }
  emit("file_downloaded", items[0].downloadUrl);
  EXPECT_TRUE(waitForStatus(0, ZQV_DOWNLOADED));
  EXPECT_TRUE(isDownloadEnabled());
}

TEST_F(DownloadSignals, FindNobodyAfterThePageHasGone) {
  items.addCount(1);
  show();
  naviframe.destroyAllViewControllers();
  emit("file_downloaded", items[0].downloadUrl);
  show();
  emit("file_downloading", items[0].downloadUrl);
  EXPECT_TRUE(waitForStatus(0, ZQV_DOWNLOADING));
  EXPECT_TRUE(errors().empty());
}

}  // namespace
