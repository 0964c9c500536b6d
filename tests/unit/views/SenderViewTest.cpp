#include "ZQVSenderView.h"

#include "ViewTest.h"
#include "WGenlistItemMonoline1Icon.h"
#include "ZQVContacts.h"

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

constexpr int kLanguageChanged = 13;

}  // namespace

class SenderView : public ViewTest {
 protected:
  void open(int recipients = 1, const char* name = "Minji", bool isGridOnly = false) {
    view = new Watched<ZQVSenderView>(&isGone, items.list(), true, isGridOnly, 7u, name, recipients,
                                      ZQV_DEFAULT_CALLER_IMAGE);
    push(view);
    Evas_Object* page = view->getEvasObj();
    grid = isGridOnly ? page : elm_object_part_content_get(page, "elm.swallow.gengrid.layout");
    list = isGridOnly ? nullptr : elm_object_part_content_get(page, "elm.swallow.recipient.text");
    ASSERT_NE(grid, nullptr);
  }
  Evas_Object* toolbar() const {
    return elm_object_item_part_content_get(view->getNaviItem(), "toolbar");
  }
  /// The toolbar's buttons, left to right.
  std::vector<Evas_Object*> buttons() const {
    std::vector<Evas_Object*> all;
    Eina_List* children = elm_box_children_get(toolbar());
    void* child = nullptr;
    EINA_LIST_FREE(children, child) all.push_back(static_cast<Evas_Object*>(child));
    return all;
  }
  Elm_Object_Item* groupRow() const { return elm_genlist_first_item_get(list); }
  Elm_Object_Item* recipientRow() const { return elm_genlist_item_next_get(groupRow()); }
  std::string rowText(Elm_Object_Item* row) const {
    const Elm_Genlist_Item_Class* rowClass = elm_genlist_item_item_class_get(row);
    char* text = rowClass->func.text_get(elm_object_item_data_get(row), list, "elm.text.main");
    std::string copy = text ? text : "(null)";
    free(text);
    return copy;
  }
  std::string title() const { return elm_object_item_text_get(view->getNaviItem()); }
  size_t cellCount() const { return elm_gengrid_items_count(grid); }

  Watched<ZQVSenderView>* view = nullptr;
  Evas_Object* grid = nullptr;
  Evas_Object* list = nullptr;
  bool isGone = false;
};

TEST_F(SenderView, HasNoViewWithoutAParent) {
  ZQVSenderView alone(items.list(), false, false, 1, nullptr, 1, nullptr);
  EXPECT_STREQ(alone.getClassName(), "ZQVSenderView");
  EXPECT_EQ(alone.onCreateView(nullptr, nullptr), nullptr);
  alone.onCreated();
  EXPECT_THAT(log.errors(), ElementsAre("parent is NULL", "parent is NULL"));
}

TEST_F(SenderView, ShowsOneRecipient) {
  items.addCount(1);
  open(1, "Minji");
  EXPECT_EQ(title(), zqvText("IDS_RSH_HEADER_SHARED_FILES_ABB"));
  EXPECT_EQ(rowText(groupRow()), zqvText("IDS_RSH_HEADER_RECIPIENT"));
  EXPECT_EQ(rowText(recipientRow()), "Minji");
  EXPECT_EQ(elm_genlist_item_select_mode_get(groupRow()), ELM_OBJECT_SELECT_MODE_NONE);
  EXPECT_EQ(elm_genlist_item_select_mode_get(recipientRow()), ELM_OBJECT_SELECT_MODE_NONE);
  EXPECT_EQ(elm_genlist_items_count(list), 2u);
}

TEST_F(SenderView, CountsSeveralRecipients) {
  open(2, "Minji,Jiho");
  EXPECT_EQ(rowText(groupRow()), zqvFormat("IDS_RSH_HEADER_RECIPIENTS_HPD_ABB", "d", 2));
  EXPECT_EQ(rowText(recipientRow()), "Minji,Jiho");
}

TEST_F(SenderView, TakesNoRecipientForOne) {
  open(0, nullptr);
  EXPECT_EQ(rowText(groupRow()), zqvText("IDS_RSH_HEADER_RECIPIENT"));
  EXPECT_EQ(rowText(recipientRow()), "");
}

TEST_F(SenderView, ShowsNamesAsTheyAre) {
  open(1, "<b>Min&ji</b> 100%s");
  EXPECT_EQ(rowText(recipientRow()), "&lt;b&gt;Min&amp;ji&lt;/b&gt; 100%s");
}

TEST_F(SenderView, PutsNineteenFilesInAtOnce) {
  items.addCount(19);
  view = new Watched<ZQVSenderView>(&isGone, items.list(), true, true, 7u, nullptr, 1, nullptr);
  naviframe.push(view);
  EXPECT_EQ(elm_gengrid_items_count(view->getEvasObj()), 19u);
  EXPECT_NE(items[18].gridItems[ZQV_VIEW_SENDER], nullptr);
}

TEST_F(SenderView, PutsTwentyFilesInLater) {
  items.addCount(20);
  view = new Watched<ZQVSenderView>(&isGone, items.list(), true, true, 7u, nullptr, 1, nullptr);
  naviframe.push(view);
  grid = view->getEvasObj();
  EXPECT_EQ(cellCount(), 0u);
  ASSERT_TRUE(waitUntil([this] { return cellCount() > 0; }));
  EXPECT_EQ(cellCount(), 11u);
  EXPECT_TRUE(waitUntil([this] { return cellCount() == 20; }));
}

TEST_F(SenderView, StopsFillingWhenItIsPopped) {
  items.addCount(500);
  open();
  naviframe.pop();
  EXPECT_TRUE(waitUntil([this] { return isGone; }));
  for (size_t i = 0; i < items.size(); ++i) EXPECT_EQ(items[i].gridItems[3], nullptr);
}

TEST_F(SenderView, LogsAMissingFileList) {
  open();
  EXPECT_THAT(log.errors(), Contains("_thumbList is NULL"));
}

TEST_F(SenderView, HasTheFilesAloneInItsReducedForm) {
  items.addCount(3);
  open(1, nullptr, true);
  EXPECT_STREQ(evas_object_type_get(view->getEvasObj()), "elm_gengrid");
  EXPECT_EQ(toolbar(), nullptr);
  EXPECT_EQ(cellCount(), 3u);
  EXPECT_EQ(evas_object_data_get(grid, "ViewType"), reinterpret_cast<void*>(3));
  int r = 0, g = 0, b = 0, a = 0;
  edje_object_color_class_get(elm_layout_edje_get(grid), "transparent", &r, &g, &b, &a, nullptr,
                              nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr);
  EXPECT_THAT((std::vector<int>{r, g, b, a}), ElementsAre(229, 237, 240, 255));
}

TEST_F(SenderView, HasRecallAndReshareInItsToolbar) {
  open();
  ASSERT_EQ(buttons().size(), 2u);
  EXPECT_EQ(textOf(buttons()[0]), zqvText("IDS_RSH_BUTTON_RECALL_ABB"));
  EXPECT_EQ(textOf(buttons()[1]), zqvText("IDS_RSH_BUTTON_RESHARE_ABB"));
  const double scale = elm_config_scale_get() / elm_app_base_scale_get();
  for (Evas_Object* button : buttons()) {
    int width = 0;
    int height = 0;
    evas_object_size_hint_min_get(button, &width, &height);
    EXPECT_EQ(width, static_cast<int>(300 * scale));
    EXPECT_EQ(height, static_cast<int>(104 * scale));
  }
}

TEST_F(SenderView, CutsScaledSizesToWholePixels) {
  const double scale = elm_config_scale_get();
  elm_config_scale_set(1.0);
  open();
  int width = 0;
  int height = 0;
  evas_object_size_hint_min_get(buttons()[0], &width, &height);
  EXPECT_EQ(width, 115) << "300 / 2.6 is 115.38";
  EXPECT_EQ(height, 40) << "104 / 2.6 is 40";
  int gap = 0;
  elm_box_padding_get(toolbar(), &gap, nullptr);
  EXPECT_EQ(gap, 12) << "32 / 2.6 is 12.3";
  elm_config_scale_set(1.3);
  view->update(kLanguageChanged);
  evas_object_size_hint_min_get(buttons()[0], &width, &height);
  EXPECT_EQ(width, 150);
  EXPECT_EQ(height, 52);
  elm_config_scale_set(scale);
}

TEST_F(SenderView, LeavesTheToolbarOutWhenAButtonCannotBeMade) {
  for (const int works : {1, 2}) {  // the back button comes first
    log.clear();
    phone.buttonsUntilFailure = works;
    open();
    phone.buttonsUntilFailure = -1;
    EXPECT_EQ(toolbar(), nullptr);
    EXPECT_THAT(log.errors(), Contains("elm_button_add btn is NULL"));
  }
}

TEST_F(SenderView, EndsTheApplicationWithItsBackButton) {
  open();
  Evas_Object* back = elm_object_item_part_content_get(view->getNaviItem(), "prev_btn");
  ASSERT_NE(back, nullptr);
  click(back);
  EXPECT_EQ(phone.exits, 1);
}

TEST_F(SenderView, OpensATappedFileInTheFullView) {
  items.addCount(3);
  for (size_t i = 0; i < 3; ++i) items[i].filePath = g_strdup("/x");
  open();
  ZQVSenderView::_gridItemCb(view, grid, items[1].gridItems[ZQV_VIEW_SENDER]);
  EXPECT_TRUE(isTop("ZQVFullView"));
  EXPECT_NE(items[1].gridItems[ZQV_VIEW_FULL_SENDER], nullptr);
}

TEST_F(SenderView, LogsHandlersThatLackTheirData) {
  items.addCount(1);
  open();
  ZQVSenderView::_gridItemCb(view, grid, nullptr);
  ZQVSenderView::_gridItemCb(nullptr, grid, items[0].gridItems[ZQV_VIEW_SENDER]);
  ZQVSenderView::_recallBtnCb(nullptr, nullptr, nullptr);
  ZQVSenderView::_reshareBtnCb(nullptr, nullptr, nullptr);
  ZQVSenderView::_rotateCb(view, nullptr, nullptr);
  ZQVSenderView::_rotateCb(nullptr, TestApp::get().window(), nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("event_info is NULL", "data is NULL", "data is NULL",
                                        "data is NULL", "data || !obj", "data || !obj"));
}

TEST_F(SenderView, SetsItsTextsAgainWhenTheLanguageChanges) {
  open(2, "Minji,Jiho");
  for (Evas_Object* button : buttons()) elm_object_text_set(button, "old");
  view->setRecipients("Minji Kim,Jiho", ZQV_GROUP_CALLER_IMAGE);
  EXPECT_EQ(rowText(recipientRow()), "Minji,Jiho") << "shown by the next update";
  view->update(14);
  EXPECT_EQ(textOf(buttons()[0]), "old");

  view->update(kLanguageChanged);
  EXPECT_EQ(title(), zqvText("IDS_RSH_HEADER_SHARED_FILES_ABB"));
  EXPECT_EQ(rowText(groupRow()), zqvFormat("IDS_RSH_HEADER_RECIPIENTS_HPD_ABB", "d", 2));
  EXPECT_EQ(rowText(recipientRow()), "Minji Kim,Jiho");
  EXPECT_EQ(textOf(buttons()[0]), zqvText("IDS_RSH_BUTTON_RECALL_ABB"));
  EXPECT_EQ(textOf(buttons()[1]), zqvText("IDS_RSH_BUTTON_RESHARE_ABB"));
}

TEST_F(SenderView, TakesNullRecipientsForEmptyOnes) {
  open();
  view->setRecipients(nullptr, nullptr);
  view->update(kLanguageChanged);
  EXPECT_EQ(rowText(recipientRow()), "");
}

TEST_F(SenderView, UpdatesItsReducedFormWithoutComplaint) {
  items.addCount(1);
  open(1, nullptr, true);
  view->update(kLanguageChanged);
  EXPECT_THAT(log.errors(), IsEmpty());
}

TEST_F(SenderView, StopsAnUpdateAtARowWithoutItsObject) {
  items.addCount(1);
  open();
  for (Elm_Object_Item* row : {groupRow(), recipientRow()}) {
    log.clear();
    elm_object_text_set(buttons()[0], "old");
    void* object = elm_object_item_data_get(row);
    elm_object_item_data_set(row, nullptr);
    view->update(kLanguageChanged);
    EXPECT_THAT(log.errors(), ElementsAre("itemData is null!"));
    EXPECT_EQ(textOf(buttons()[0]), "old");
    elm_object_item_data_set(row, object);
  }
}

TEST_F(SenderView, ForgetsItsCellsWhenAllPagesAreDestroyed) {
  items.addCount(30);
  open();
  naviframe.destroyAllViewControllers();
  EXPECT_TRUE(isGone);
  for (size_t i = 0; i < items.size(); ++i) EXPECT_EQ(items[i].gridItems[3], nullptr);
}
