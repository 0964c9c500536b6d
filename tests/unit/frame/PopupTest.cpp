#include <algorithm>

#include "FramePages.h"

using app_assist::WPopupController;

namespace {

class FakePopup : public WPopupController {
 public:
  FakePopup(Record& record, FakePopup** slot) : _record(record), _slot(slot) {}
  ~FakePopup() override { _record.push_back("popup gone"); }
  Evas_Object* onViewDeleted(Evas_Object* view) override {
    _record.push_back("popup view deleted");
    *_slot = nullptr;
    return view;
  }

 private:
  Record& _record;
  FakePopup** _slot;
};

class Popup : public FrameTest {
 protected:
  Popup() { page = pushed("page"); }

  FakePopup* newPopup() {
    slot = new FakePopup(record, &slot);
    slot->setTitle("Title");
    slot->setContent("Text");
    return slot;
  }
  void press(int number) {
    const std::string part = "button" + std::to_string(number);
    Evas_Object* button = elm_object_part_content_get(slot->getEvasObj(), part.c_str());
    ASSERT_TRUE(button);
    evas_object_smart_callback_call(button, "clicked", nullptr);
  }
  void pressBack() {
    evas_event_feed_key_down(evas_object_evas_get(window->getEvasObj()), "XF86Back", "XF86Back",
                             nullptr, nullptr, 0, nullptr);
    evas_event_feed_key_up(evas_object_evas_get(window->getEvasObj()), "XF86Back", "XF86Back",
                           nullptr, nullptr, 0, nullptr);
  }

  ptrdiff_t positionOf(const char* entry) const {
    return std::find(record.begin(), record.end(), entry) - record.begin();
  }

  FakePage* page;
  FakePopup* slot = nullptr;
};

}  // namespace

TEST_F(Popup, ShowsTitleTextAndButtonsInTheirParts) {
  newPopup()->addButton("Cancel", nullptr);
  slot->addButton("OK", nullptr);
  page->attachPopup(slot);
  Evas_Object* popup = slot->getEvasObj();
  EXPECT_STREQ(elm_object_part_text_get(popup, "title,text"), "Title");
  EXPECT_STREQ(elm_object_text_get(popup), "Text");
  Evas_Object* second = elm_object_part_content_get(popup, "button2");
  EXPECT_STREQ(elm_object_text_get(second), "OK");
  EXPECT_STREQ(elm_object_style_get(second), "popup/default");
  EXPECT_EQ(elm_object_part_content_get(popup, "button3"), nullptr);
  EXPECT_EQ(elm_popup_orient_get(popup), ELM_POPUP_ORIENT_BOTTOM);
}

TEST_F(Popup, MakesItsTextsTranslatableInItsDomain) {
  newPopup()->setTextDomain("zelqo");
  slot->addButton("IDS_OK", nullptr);
  page->attachPopup(slot);
  Evas_Object* popup = slot->getEvasObj();
  EXPECT_STREQ(elm_object_translatable_part_text_get(popup, "title,text"), "Title");
  EXPECT_STREQ(elm_object_translatable_text_get(elm_object_part_content_get(popup, "button1")),
               "IDS_OK");
}

TEST_F(Popup, ShowsTheContentThatIsBuiltForIt) {
  Evas_Object* content = nullptr;
  newPopup()->setContent(nullptr);
  slot->setContent([&](Evas_Object* popup) { return content = elm_layout_add(popup); });
  page->attachPopup(slot);
  EXPECT_TRUE(content);
  EXPECT_EQ(elm_object_content_get(slot->getEvasObj()), content);
}

TEST_F(Popup, ClosesAfterTheHandlerThatAskedForIt) {
  newPopup()->addButton("OK", [&](bool* close) {
    *close = true;
    record.push_back("handled");
  });
  page->attachPopup(slot);
  press(1);
  EXPECT_EQ(record, (Record{"handled"}));
  EXPECT_TRUE(waitUntil([&] { return has("popup gone"); }));
  EXPECT_EQ(record, (Record{"handled", "popup view deleted", "popup gone"}));
  EXPECT_EQ(slot, nullptr);
}

TEST_F(Popup, SlidesOutBeforeItGoes) {
  page->attachPopup(newPopup());
  evas_object_smart_callback_add(
      slot->getEvasObj(), "dismissed",
      [](void* data, Evas_Object*, void*) {
        static_cast<Record*>(data)->push_back("out of sight");
      },
      &record);
  slot->close();
  EXPECT_TRUE(waitUntil([&] { return has("popup gone"); }));
  EXPECT_EQ(record, (Record{"out of sight", "popup view deleted", "popup gone"}));
}

TEST_F(Popup, GoesWithItsPageWhileItSlidesOut) {
  page->attachPopup(newPopup());
  slot->close();
  naviframe->destroyAllViewControllers();
  EXPECT_EQ(record, (Record{"popup view deleted", "popup gone", "page view deleted", "page gone"}));
}

TEST_F(Popup, EndsWhenItsObjectIsDeletedWhileItSlidesOut) {
  page->attachPopup(newPopup());
  slot->close();
  evas_object_del(slot->getEvasObj());
  EXPECT_EQ(slot, nullptr);
  EXPECT_TRUE(waitUntil([&] { return has("popup gone"); }));
}

TEST_F(Popup, StaysWhenTheHandlerDoesNotCloseIt) {
  newPopup()->addButton("OK", [](bool*) {});
  page->attachPopup(slot);
  press(1);
  passLoop();
  EXPECT_TRUE(record.empty());
}

TEST_F(Popup, HandlesNoButtonOnceItCloses) {
  int presses = 0;
  newPopup()->addButton("OK", [&](bool* close) {
    *close = true;
    presses++;
  });
  page->attachPopup(slot);
  press(1);
  press(1);
  EXPECT_EQ(presses, 1);
}

TEST_F(Popup, MayBeClosedByItsHandlerAndByTheAnswerToo) {
  newPopup()->addButton("OK", [&](bool* close) {
    slot->close();
    *close = true;
  });
  page->attachPopup(slot);
  press(1);
  EXPECT_TRUE(waitUntil([&] { return has("popup gone"); }));
}

TEST_F(Popup, LetsItsHandlerPopThePage) {
  pushed("above");
  newPopup()->addButton("OK", [&](bool* close) {
    naviframe->pop();
    *close = true;
  });
  auto* top = static_cast<FakePage*>(
      elm_object_item_data_get(elm_naviframe_top_item_get(naviframe->getEvasObj())));
  top->attachPopup(slot);
  press(1);
  EXPECT_TRUE(waitUntil([&] { return has("above gone"); }));
  EXPECT_LT(positionOf("popup view deleted"), positionOf("popup gone"));
  EXPECT_LT(positionOf("popup gone"), positionOf("above view deleted"));
}

TEST_F(Popup, GoesBeforeItsPageWhenAllPagesAreDestroyed) {
  page->attachPopup(newPopup());
  naviframe->destroyAllViewControllers();
  EXPECT_EQ(record, (Record{"popup view deleted", "popup gone", "page view deleted", "page gone"}));
}

TEST_F(Popup, ClosesOnBackBeforeThePageDoes) {
  page->attachPopup(newPopup());
  pressBack();
  EXPECT_TRUE(waitUntil([&] { return has("popup gone"); }));
  EXPECT_FALSE(has("page pop"));
  pressBack();
  EXPECT_TRUE(has("page pop"));
}

TEST_F(Popup, OfTheApplicationItselfShieldsThePageFromBack) {
  Evas_Object* own = elm_popup_add(window->getEvasObj());
  evas_object_show(own);
  pressBack();
  EXPECT_FALSE(has("page pop"));
  EXPECT_TRUE(evas_object_visible_get(own));
  evas_object_del(own);
  pressBack();
  EXPECT_TRUE(has("page pop"));
}

TEST_F(Popup, CanBeAttachedWhileAnotherStillCloses) {
  page->attachPopup(newPopup());
  slot->close();
  FakePopup* second = nullptr;
  second = new FakePopup(record, &second);
  page->attachPopup(second);
  EXPECT_TRUE(waitUntil([&] { return has("popup gone"); }));
  ASSERT_TRUE(second);
  EXPECT_TRUE(evas_object_visible_get(second->getEvasObj()));
  naviframe->destroyAllViewControllers();
  EXPECT_EQ(second, nullptr);
}

TEST_F(Popup, EndsWhenItsObjectIsDeleted) {
  page->attachPopup(newPopup());
  evas_object_del(slot->getEvasObj());
  EXPECT_EQ(slot, nullptr);
  EXPECT_TRUE(waitUntil([&] { return has("popup gone"); }));
}

TEST_F(Popup, TakesNoMoreThanThreeButtons) {
  newPopup();
  for (const char* id : {"1", "2", "3", "4"}) slot->addButton(id, nullptr);
  page->attachPopup(slot);
  EXPECT_TRUE(elm_object_part_content_get(slot->getEvasObj(), "button3"));
}
