#include "ZQVSelectView.h"

#include <libintl.h>

#include "ViewTest.h"
#include "WGenlistItemMonoline1Check.h"
#include "ZQVRows.h"

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;

namespace {

constexpr uint32_t kLimit = 6291456;
constexpr int kLanguageChanged = 13;

/// What a widget shows for an id: it only looks into the application's own catalogue.
const char* widgetText(const char* id) {
  return dgettext(ZQV_TEXT_DOMAIN, id);
}

}  // namespace

class SelectView : public ViewTest {
 protected:
  void open() {
    view = new Watched<ZQVSelectView>(&isGone, items.list(), "Minji", "token-1");
    push(view);
    grid = elm_object_part_content_get(view->getEvasObj(), "elm.swallow.gengrid.layout");
    list = elm_object_part_content_get(view->getEvasObj(), "elm.swallow.recipient.text");
    ASSERT_NE(grid, nullptr);
    ASSERT_NE(list, nullptr);
  }
  Evas_Object* button(const char* part) const {
    return elm_object_item_part_content_get(view->getNaviItem(), part);
  }
  Evas_Object* done() const { return button("title_right_btn"); }
  Evas_Object* cancel() const { return button("title_left_btn"); }
  std::string title() const { return elm_object_item_text_get(view->getNaviItem()); }
  Elm_Object_Item* row() const { return elm_genlist_first_item_get(list); }
  bool isAllChecked() const {
    return zqvRowOf<WGenlistItemMonoline1Check>(elm_object_item_data_get(row()))->isChecked();
  }
  void tap(int item) { ZQVSelectView::_gridItemCb(view, grid, items[item].gridItems[2]); }
  void tapAll() { ZQVSelectView::_listItemCb(view, list, row()); }
  int checkedCount() const {
    int count = 0;
    for (size_t i = 0; i < items.size(); ++i) count += items[i].checked;
    return count;
  }
  std::string countTitle(int count) const {
    return zqvFormat("IDS_RSH_HEADER_PD_SELECTED_ABB", "d", count);
  }
  bool waitUntilGone() {
    return waitUntil([this] { return isGone; });
  }

  Watched<ZQVSelectView>* view = nullptr;
  Evas_Object* grid = nullptr;
  Evas_Object* list = nullptr;
  bool isGone = false;
};

TEST_F(SelectView, AnswersItsClassName) {
  open();
  EXPECT_STREQ(view->getClassName(), "ZQVSelectView");
}

TEST_F(SelectView, HasNoViewWithoutAParent) {
  ZQVSelectView alone(items.list(), nullptr, nullptr);
  EXPECT_EQ(alone.onCreateView(nullptr, nullptr), nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("parent is NULL"));
}

TEST_F(SelectView, ShowsOnlyFilesThatAreNotOnTheirWay) {
  items.addCount(4);
  items.addNothing();
  for (int i = 0; i < 4; ++i) items[i].downloadStatus = i;
  open();
  EXPECT_EQ(elm_gengrid_items_count(grid), 2u);
  EXPECT_NE(items[0].gridItems[ZQV_VIEW_SELECT], nullptr);
  EXPECT_EQ(items[1].gridItems[ZQV_VIEW_SELECT], nullptr);
  EXPECT_EQ(items[2].gridItems[ZQV_VIEW_SELECT], nullptr);
  EXPECT_NE(items[3].gridItems[ZQV_VIEW_SELECT], nullptr);
}

TEST_F(SelectView, OpensWithNothingSelectedWhateverWasLeftBehind) {
  items.addCount(3);
  items[1].checked = true;
  open();
  EXPECT_EQ(checkedCount(), 0);
  EXPECT_FALSE(isEnabled(done()));
  EXPECT_TRUE(isEnabled(cancel()));
  EXPECT_EQ(title(), zqvText("IDS_RSH_HEADER_SELECT_ITEMS_ABB3"));
  EXPECT_EQ(textOf(done()), widgetText("IDS_TPLATFORM_ACBUTTON_DONE_ABB"));
  EXPECT_EQ(textOf(cancel()), widgetText("IDS_TPLATFORM_ACBUTTON_CANCEL_ABB"));
}

TEST_F(SelectView, MarksItsGridAsSelectGrid) {
  open();
  EXPECT_EQ(evas_object_data_get(grid, "ViewType"), reinterpret_cast<void*>(2));
}

TEST_F(SelectView, CountsTheCheckedFilesInItsTitle) {
  items.addCount(3);
  open();
  tap(0);
  EXPECT_TRUE(items[0].checked);
  EXPECT_EQ(title(), countTitle(1));
  EXPECT_TRUE(isEnabled(done()));
  tap(2);
  EXPECT_EQ(title(), countTitle(2));
  tap(0);
  tap(2);
  EXPECT_EQ(checkedCount(), 0);
  EXPECT_EQ(title(), zqvText("IDS_RSH_HEADER_SELECT_ITEMS_ABB3"));
  EXPECT_FALSE(isEnabled(done()));
}

TEST_F(SelectView, TurnsSelectAllOnWithTheLastFileAndOffWithTheFirstUnchecked) {
  items.addCount(3);
  open();
  tap(0);
  tap(1);
  EXPECT_FALSE(isAllChecked());
  tap(2);
  EXPECT_TRUE(isAllChecked());
  tap(1);
  EXPECT_FALSE(isAllChecked());
}

TEST_F(SelectView, ShowsTheStateInTheCellsCheckBox) {
  items.addCount(2);
  open();
  const auto check = [this] {
    return elm_object_item_part_content_get(items[0].gridItems[2], "elm.swallow.end");
  };
  ASSERT_TRUE(waitUntil([&] { return check() != nullptr; }));
  tap(0);
  EXPECT_TRUE(elm_check_state_get(check()));
  tapAll();
  EXPECT_TRUE(elm_check_state_get(check()));
  tapAll();
  EXPECT_FALSE(elm_check_state_get(check()));
}

TEST_F(SelectView, SelectsAndClearsAll) {
  items.addCount(5);
  open();
  tap(3);
  tapAll();
  EXPECT_TRUE(isAllChecked());
  EXPECT_EQ(checkedCount(), 5);
  EXPECT_EQ(title(), countTitle(5));
  tapAll();
  EXPECT_FALSE(isAllChecked());
  EXPECT_EQ(checkedCount(), 0);
  EXPECT_FALSE(isEnabled(done()));
}

TEST_F(SelectView, SelectsAThousandFilesMostOfThemOutOfSight) {
  items.addCount(1000);
  open();
  tapAll();
  EXPECT_EQ(checkedCount(), 1000);
  EXPECT_EQ(title(), countTitle(1000));
  EXPECT_THAT(log.errors(), Not(Contains("Fail to get check")));
  click(done());
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_EQ(phone.launches[0].extra("url").size(), 1000u);
  EXPECT_THAT(phone.usageOf("ZQ52"), IsEmpty()) << "more than 100 files have no bucket";
}

TEST_F(SelectView, EnablesDoneForSelectAllOverAnEmptyGridAndDoneDoesNothing) {
  items.addCount(2);
  items[0].downloadStatus = ZQV_DOWNLOADING;
  items[1].downloadStatus = ZQV_REQUESTED;
  open();
  tapAll();
  EXPECT_TRUE(isEnabled(done()));
  EXPECT_EQ(title(), zqvText("IDS_RSH_HEADER_SELECT_ITEMS_ABB3"));
  EXPECT_EQ(checkedCount(), 0);
  click(done());
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.usage, IsEmpty());
  EXPECT_TRUE(isTop("ZQVSelectView"));
}

TEST_F(SelectView, HandsExactlyTheCheckedFilesOverAndLeaves) {
  items.addCount(5);
  open();
  tap(1);
  tap(3);
  click(done());
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("name"), ElementsAre("file1.pdf", "file3.pdf"));
  EXPECT_THAT(phone.launches[0].extra("sender"), ElementsAre("Minji"));
  EXPECT_THAT(phone.launches[0].extra("token"), ElementsAre("token-1"));
  EXPECT_THAT(phone.launches[0].extra("wifi_check"), ElementsAre("0"));
  EXPECT_THAT(phone.usageOf("ZQ52"), ElementsAre("1_10"));
  EXPECT_THAT(phone.usageOf("ZQ51"), ElementsAre("Document", "Document"));
  EXPECT_EQ(items[1].downloadStatus, ZQV_REQUESTED);
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
  EXPECT_EQ(items[1].gridItems[ZQV_VIEW_SELECT], nullptr);
  EXPECT_TRUE(waitUntilGone());
  EXPECT_EQ(checkedCount(), 0) << "the checks are cleared when the page is gone";
  EXPECT_TRUE(isTop("BlankPage"));
}

TEST_F(SelectView, HandsOverOnceHoweverOftenDoneIsTapped) {
  items.addCount(1);
  open();
  tap(0);
  Evas_Object* button = done();
  click(button);
  click(button);
  EXPECT_EQ(phone.launches.size(), 1u);
  EXPECT_TRUE(waitUntilGone());
  EXPECT_TRUE(isTop("BlankPage"));
}

TEST_F(SelectView, NamesTheNewSenderAfterItChanged) {
  items.addCount(1);
  open();
  view->setName("Jiho");
  tap(0);
  click(done());
  EXPECT_THAT(phone.launches[0].extra("sender"), ElementsAre("Jiho"));
}

TEST_F(SelectView, SendsNoSenderWithoutAName) {
  items.addCount(1);
  open();
  view->setName(nullptr);
  tap(0);
  click(done());
  EXPECT_THAT(phone.launches[0].keys(), Not(Contains("sender")));
}

TEST_F(SelectView, StaysAndSaysSoWithoutAConnection) {
  items.addCount(1);
  open();
  tap(0);
  phone.network = CONNECTION_TYPE_DISCONNECTED;
  click(done());
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.statusMessages,
              ElementsAre(zqvText(
                  "IDS_MF_POP_MOBILE_DATA_IS_TURNED_OFF_CONNECT_TO_A_WI_FI_NETWORK_INSTEAD_MSG")));
  EXPECT_TRUE(isTop("ZQVSelectView"));
  EXPECT_TRUE(items[0].checked);
}

TEST_F(SelectView, DownloadsTheLimitItselfWithoutAsking) {
  items.add("a.mp4", kLimit - 1);
  items.add("b.mp4", 1);
  open();
  tapAll();
  click(done());
  EXPECT_EQ(phone.launches.size(), 1u);
  EXPECT_EQ(popup(), nullptr);
}

TEST_F(SelectView, AsksForOneByteMoreThanTheLimit) {
  items.add("a.mp4", kLimit);
  items.add("b.mp4", 1);
  open();
  tapAll();
  click(done());
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_TRUE(waitForPopup());
  EXPECT_TRUE(isTop("ZQVSelectView"));
}

TEST_F(SelectView, AddsSizesBeyond32Bits) {
  items.add("a.mp4", 4294967295u);
  items.add("b.mp4", 1);
  open();
  tapAll();
  click(done());
  EXPECT_THAT(phone.launches, IsEmpty()) << "the sum is not taken for 0 bytes";
  EXPECT_TRUE(waitForPopup());
}

TEST_F(SelectView, HandsOverFromThePopupAndTakesItAlong) {
  items.add("a.mp4", kLimit + 1);
  open();
  tapAll();
  click(done());
  ASSERT_TRUE(waitForPopup());
  click(popupButton(2));
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("wifi_check"), ElementsAre("0"));
  EXPECT_TRUE(waitUntilGone());
  EXPECT_TRUE(waitForNoPopup());
}

TEST_F(SelectView, StaysWithPopupWhenWifiIsWantedAndMissing) {
  items.add("a.mp4", kLimit + 1);
  open();
  tapAll();
  click(done());
  ASSERT_TRUE(waitForPopup());
  Evas_Object* check =
      elm_object_part_content_get(elm_object_content_get(popup()), "elm.swallow.check");
  elm_check_state_set(check, EINA_TRUE);
  evas_object_smart_callback_call(check, "changed", nullptr);
  phone.network = CONNECTION_TYPE_CELLULAR;
  click(popupButton(2));
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(
      phone.statusMessages,
      ElementsAre(zqvText(
          "IDS_RSH_TPOP_WI_FI_NOT_AVAILABLE_TURN_ON_WI_FI_OR_DESELECT_DOWNLOAD_VIA_WI_FI_ONLY")));
  ASSERT_NE(popup(), nullptr);

  phone.network = CONNECTION_TYPE_WIFI;
  click(popupButton(2));
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("wifi_check"), ElementsAre("1"));
  EXPECT_TRUE(waitUntilGone());
}

TEST_F(SelectView, RemembersTheWifiWishForASmallerDownload) {
  items.add("a.mp4", kLimit + 1);
  items.add("b.mp4", 1);
  open();
  tap(0);
  click(done());
  ASSERT_TRUE(waitForPopup());
  Evas_Object* check =
      elm_object_part_content_get(elm_object_content_get(popup()), "elm.swallow.check");
  elm_check_state_set(check, EINA_TRUE);
  evas_object_smart_callback_call(check, "changed", nullptr);
  phone.network = CONNECTION_TYPE_CELLULAR;
  click(popupButton(2));
  click(popupButton(1));
  ASSERT_TRUE(waitForNoPopup());
  tap(0);
  tap(1);
  click(done());
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("wifi_check"), ElementsAre("1"));
}

TEST_F(SelectView, ForgetsTheChecksOnCancelAndLeaves) {
  items.addCount(3);
  open();
  tapAll();
  click(cancel());
  EXPECT_EQ(checkedCount(), 0);
  EXPECT_TRUE(waitUntilGone());
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_TRUE(isTop("BlankPage"));
}

TEST_F(SelectView, ForgetsTheChecksOnBackToo) {
  items.addCount(3);
  open();
  tapAll();
  naviframe.pop();
  EXPECT_EQ(items[0].gridItems[ZQV_VIEW_SELECT], nullptr);
  EXPECT_TRUE(waitUntilGone());
  EXPECT_EQ(checkedCount(), 0);
}

TEST_F(SelectView, ForgetsItsCellsWhenAllPagesAreDestroyed) {
  items.addCount(3);
  open();
  naviframe.destroyAllViewControllers();
  EXPECT_TRUE(isGone);
  for (size_t i = 0; i < items.size(); ++i) EXPECT_EQ(items[i].gridItems[2], nullptr);
}

TEST_F(SelectView, ClosesItsPopupWithAllPages) {
  items.add("a.mp4", kLimit + 1);
  open();
  tapAll();
  click(done());
  ASSERT_TRUE(waitForPopup());
  naviframe.destroyAllViewControllers();
  EXPECT_TRUE(isGone);
  EXPECT_TRUE(waitForNoPopup());
}

TEST_F(SelectView, SetsItsTextsAgainWhenTheLanguageChanges) {
  items.addCount(2);
  open();
  elm_object_text_set(done(), "old");
  elm_object_text_set(cancel(), "old");
  view->update(kLanguageChanged);
  EXPECT_EQ(title(), zqvText("IDS_RSH_HEADER_SELECT_ITEMS_ABB3"));
  EXPECT_EQ(textOf(done()), widgetText("IDS_TPLATFORM_ACBUTTON_DONE_ABB"));
  EXPECT_EQ(textOf(cancel()), widgetText("IDS_TPLATFORM_ACBUTTON_CANCEL_ABB"));
  tap(1);
  view->update(kLanguageChanged);
  EXPECT_EQ(title(), countTitle(1));
}

TEST_F(SelectView, IgnoresOtherEvents) {
  open();
  elm_object_text_set(done(), "old");
  for (const int event : {0, 12, 14, 16, -1}) view->update(event);
  EXPECT_EQ(textOf(done()), "old");
}

TEST_F(SelectView, LogsAMissingTitleButtonAndStops) {
  open();
  elm_object_text_set(cancel(), "old");
  evas_object_del(elm_object_item_part_content_unset(view->getNaviItem(), "title_right_btn"));
  view->update(kLanguageChanged);
  EXPECT_THAT(log.errors(), ElementsAre("toolbar part object is null!"));
  EXPECT_EQ(textOf(cancel()), "old");
}

TEST_F(SelectView, ForwardsALanguageChangeToItsPopup) {
  items.add("a.mp4", kLimit + 1);
  open();
  tapAll();
  click(done());
  ASSERT_TRUE(waitForPopup());
  elm_object_text_set(popupButton(1), "old");
  view->update(kLanguageChanged);
  EXPECT_EQ(textOf(popupButton(1)), zqvText("IDS_RSH_BUTTON_CANCEL_ABB2"));
}

TEST_F(SelectView, LogsHandlersThatLackTheirData) {
  open();
  ZQVSelectView::_gridItemCb(nullptr, grid, nullptr);
  ZQVSelectView::_doneBtnCb(nullptr, nullptr, nullptr);
  ZQVSelectView::_cancelBtnCb(nullptr, nullptr, nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("data is NULL", "data is NULL", "data is NULL"));
  log.clear();
  ZQVSelectView::_gridItemCb(view, grid, nullptr);
  EXPECT_THAT(log.errors(), IsEmpty());
  ZQVSelectView::_listItemCb(view, list, nullptr);
  ZQVSelectView::_listItemCb(nullptr, list, row());
  EXPECT_THAT(log.errors(), ElementsAre("Invalid argument: event info is NULL",
                                        "Invalid argument: data is NULL"));
  log.clear();
  ZQVSelectView::_rotateCb(nullptr, TestApp::get().window(), nullptr);
  ZQVSelectView::_rotateCb(view, nullptr, nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("data || !obj", "data || !obj"));
}

TEST_F(SelectView, LogsAListRowWithoutItsObject) {
  open();
  void* object = elm_object_item_data_get(row());
  elm_object_item_data_set(row(), nullptr);
  tapAll();
  EXPECT_THAT(log.errors(), ElementsAre("list_item is NULL"));
  elm_object_item_data_set(row(), object);
}

TEST_F(SelectView, LogsAMissingGrid) {
  items.addCount(2);
  open();
  evas_object_del(grid);
  EXPECT_EQ(items[0].gridItems[ZQV_VIEW_SELECT], nullptr);
  tapAll();
  EXPECT_TRUE(isAllChecked()) << "the row has changed already";
  click(done());
  EXPECT_THAT(log.errors(), ElementsAre("Fail to get gengrid", "Get gengrid failed"));
}
