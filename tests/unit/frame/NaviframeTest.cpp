#include <malloc.h>

#include <algorithm>

#include "FramePages.h"

using Naviframe = FrameTest;

namespace {

constexpr int kLayouts = 1000;

/// As many layouts as the pages of some launches have together.
class CrowdedPage : public FakePage {
 public:
  using FakePage::FakePage;
  Evas_Object* onCreateView(Evas_Object* parent, void*) override {
    Evas_Object* box = elm_box_add(parent);
    for (int i = 0; i < kLayouts; i++) elm_box_pack_end(box, elm_layout_add(box));
    return box;
  }
};

}  // namespace

TEST_F(Naviframe, BuildsAPageInOrder) {
  pushedJustNow("a");
  EXPECT_EQ(record, (Record{"a view", "a created", "a push", "a pushed"}));
}

TEST_F(Naviframe, GivesThePageItsParameterWindowNaviframeAndItem) {
  auto* page = new FakePage(record, "a");
  int parameter = 0;
  naviframe->push(page, &parameter, "fullview");
  EXPECT_EQ(page->viewParam, &parameter);
  EXPECT_EQ(page->getWindowController(), window);
  EXPECT_EQ(page->getNaviframe(), naviframe);
  EXPECT_STREQ(page->getItemStyle(), "fullview");
  EXPECT_EQ(elm_object_item_data_get(page->getNaviItem()), page);
  EXPECT_STREQ(elm_naviframe_item_style_get(page->getNaviItem()), "fullview");
}

TEST_F(Naviframe, ShowsATitleThatIsSetLater) {
  FakePage* page = pushed("a");
  page->setTitle("Later");
  EXPECT_STREQ(elm_object_item_text_get(page->getNaviItem()), "Later");
  page->setTitle(nullptr);
  EXPECT_STREQ(page->getTitle(), "");
}

TEST_F(Naviframe, LeavesNothingOfTheLayoutsOfAPage) {
#ifdef __SANITIZE_ADDRESS__
  GTEST_SKIP() << "the sanitizer's memory is not counted";
#endif
  constexpr size_t kRounds = 4;
  const auto used = [] {
    eina_freeq_clear(eina_freeq_main_get());
    return mallinfo2().uordblks;
  };
  const auto growth = [&] {
    const size_t before = used();
    for (size_t i = 0; i < kRounds; i++) {
      record.clear();
      naviframe->push(new CrowdedPage(record, "a"));
      passLoop();
      naviframe->destroyAllViewControllers();
      EXPECT_TRUE(has("a gone"));
      runPastTransitions();
    }
    const size_t after = used();
    return after > before ? after - before : 0;
  };
  // Now and then the toolkit keeps or gives back megabytes of its own. What it forgot of a layout
  // would be 32 bytes every time.
  size_t least = growth();
  for (int i = 0; i < 8 && least >= kRounds * kLayouts * 16; i++) least = std::min(least, growth());
  EXPECT_LT(least, kRounds * kLayouts * 16);
}

TEST_F(Naviframe, DestroysAPageThatCannotBeCreated) {
  auto* page = new FakePage(record, "a");
  page->hasView = false;
  naviframe->push(page);
  EXPECT_FALSE(has("a gone"));
  EXPECT_TRUE(waitUntil([&] { return has("a gone"); }));
  EXPECT_EQ(pages(), 0);
}

TEST_F(Naviframe, DestroysAPageThatRefusesItsCreation) {
  auto* page = new FakePage(record, "a");
  page->prepares = false;
  naviframe->push(page);
  EXPECT_TRUE(waitUntil([&] { return has("a gone"); }));
  EXPECT_FALSE(has("a view"));
}

TEST_F(Naviframe, IgnoresAPageThatIsNone) {
  naviframe->push(nullptr);
  EXPECT_EQ(pages(), 0);
}

TEST_F(Naviframe, DestroysAPoppedPageAfterTheCallerReturned) {
  pushed("a");
  pushed("b");
  naviframe->pop();
  EXPECT_EQ(record, (Record{"b pop"}));
  EXPECT_TRUE(waitUntil([&] { return has("b gone"); }));
  EXPECT_EQ(record, (Record{"b pop", "a top", "b view deleted", "b gone"}));
}

TEST_F(Naviframe, KeepsAPageThatRefusesToBePopped) {
  pushed("a");
  pushed("b")->allowsPop = false;
  naviframe->pop();
  runPastTransitions();
  EXPECT_EQ(pages(), 2);
  EXPECT_EQ(record, (Record{"b pop"}));
}

TEST_F(Naviframe, KeepsTheLastPageWhenItsPopIsHandled) {
  int asked = 0;
  naviframe->setOnLastItemPop([&](bool* handled) {
    asked++;
    *handled = true;
  });
  pushed("a");
  naviframe->pop();
  runPastTransitions();
  EXPECT_EQ(asked, 1);
  EXPECT_EQ(pages(), 1);
  EXPECT_TRUE(record.empty());
}

TEST_F(Naviframe, PopsTheLastPageWhenNobodyHandlesThat) {
  naviframe->setOnLastItemPop([](bool*) {});
  pushed("a");
  naviframe->pop();
  EXPECT_TRUE(waitUntil([&] { return has("a gone"); }));
  EXPECT_EQ(pages(), 0);
}

TEST_F(Naviframe, AsksNobodyAboutTheLastPageWhileThereIsAnother) {
  naviframe->setOnLastItemPop([](bool*) { ADD_FAILURE() << "two pages"; });
  pushed("a");
  pushed("b");
  naviframe->pop();
  EXPECT_TRUE(waitUntil([&] { return has("b gone"); }));
}

TEST_F(Naviframe, PopsAfterThePushWhenBackCameDuringIt) {
  pushed("a");
  pushedJustNow("b");
  naviframe->pop();
  EXPECT_FALSE(has("b pop"));
  EXPECT_TRUE(waitUntil([&] { return has("b gone"); }));
  EXPECT_EQ(pages(), 1);
}

TEST_F(Naviframe, LosesNoneOfTwoPressesOfBackDuringAPush) {
  naviframe->setOnLastItemPop([&](bool* handled) {
    *handled = true;
    record.push_back("last");
  });
  pushed("a");
  pushedJustNow("b");
  naviframe->pop();
  naviframe->pop();
  EXPECT_TRUE(waitUntil([&] { return has("b gone") && has("last"); }));
}

TEST_F(Naviframe, DoesNotCallAPageTopThatIsCoveredAgain) {
  pushed("a");
  pushed("b");
  naviframe->pop();
  pushedJustNow("c");
  EXPECT_TRUE(waitUntil([&] { return has("b gone"); }));
  EXPECT_FALSE(has("a top"));
}

TEST_F(Naviframe, DestroysAllPagesAtOnceAndAsksNone) {
  naviframe->setOnLastItemPop([](bool*) { ADD_FAILURE() << "not a pop"; });
  pushed("a");
  pushed("b");
  naviframe->destroyAllViewControllers();
  EXPECT_EQ(record, (Record{"b view deleted", "a view deleted", "b gone", "a gone"}));
  EXPECT_EQ(pages(), 0);
}

TEST_F(Naviframe, DestroysAllPagesWhileOneSlidesIn) {
  pushed("a");
  pushedJustNow("b");
  naviframe->destroyAllViewControllers();
  EXPECT_TRUE(has("a gone"));
  EXPECT_TRUE(has("b gone"));
  runPastTransitions();
}

TEST_F(Naviframe, DestroysAllPagesWhileOneSlidesOut) {
  pushed("a");
  pushed("b");
  naviframe->pop();
  naviframe->destroyAllViewControllers();
  EXPECT_TRUE(has("a gone"));
  EXPECT_TRUE(has("b gone"));
  EXPECT_FALSE(has("a top"));
  runPastTransitions();
}

TEST_F(Naviframe, ForgetsAnEarlyBackWhenAllPagesAreDestroyed) {
  pushed("a");
  pushedJustNow("b");
  naviframe->pop();
  naviframe->destroyAllViewControllers();
  pushed("c");
  EXPECT_EQ(pages(), 1);
  EXPECT_FALSE(has("c pop"));
}

TEST_F(Naviframe, EndsAPageWhoseItemIsDeleted) {
  FakePage* page = pushed("a");
  elm_object_item_del(page->getNaviItem());
  EXPECT_TRUE(waitUntil([&] { return has("a gone"); }));
}

TEST_F(Naviframe, OutlivesManyHastyPushesAndPops) {
  for (int round = 0; round < 40; round++) {
    pushedJustNow("a");
    if (round % 2) pushedJustNow("b");
    if (round % 3) naviframe->pop();
    if (round % 5 == 0) passLoop();
    if (round % 7 == 0) naviframe->destroyAllViewControllers();
  }
  runPastTransitions();
  naviframe->destroyAllViewControllers();
  int created = 0, gone = 0;
  for (const std::string& entry : record) {
    created += entry.find(" created") != std::string::npos;
    gone += entry.find(" gone") != std::string::npos;
  }
  EXPECT_EQ(created, gone);
}
