// What stays on the screen when an Arabic or Hebrew interface becomes an English one, or back.

#include "Direction.h"

#include "FramePages.h"

namespace {

class TurnedWindow : public FrameTest {
 protected:
  ~TurnedWindow() override { elm_config_mirrored_set(EINA_FALSE); }

  void turn(bool toTheLeft) {
    elm_config_mirrored_set(toTheLeft);
    app_assist::followDirection(window->getEvasObj());
  }
};

/// A list of one row; its words do not matter.
class ListPage : public app_assist::WContentViewController {
 public:
  explicit ListPage(Elm_Object_Item** row) : _row(row) {}
  Evas_Object* onCreateView(Evas_Object* parent, void*) override {
    Evas_Object* list = elm_genlist_add(parent);
    elm_genlist_mode_set(list, ELM_LIST_COMPRESS);
    _class = elm_genlist_item_class_new();
    _class->item_style = "1line";
    *_row = elm_genlist_item_append(list, _class, nullptr, nullptr, ELM_GENLIST_ITEM_NONE, nullptr,
                                    nullptr);
    elm_genlist_item_class_free(_class);
    return list;
  }

 private:
  Elm_Object_Item** const _row;
  Elm_Genlist_Item_Class* _class = nullptr;
};

bool isShown(Elm_Object_Item* row) {
  Evas_Object* object = elm_object_item_track(row);
  const bool isShown = object && evas_object_visible_get(object);
  if (object) elm_object_item_untrack(row);
  return isShown;
}

int leftOf(Evas_Object* object) {
  int x = 0;
  evas_object_geometry_get(object, &x, nullptr, nullptr, nullptr);
  return x;
}

}  // namespace

TEST_F(TurnedWindow, KeepsTheRowsOfItsLists) {
  Elm_Object_Item* row = nullptr;
  naviframe->push(new ListPage(&row));
  ASSERT_TRUE(waitUntil([&] { return isShown(row); }));
  for (const bool toTheLeft : {true, false}) {
    turn(toTheLeft);
    passLoop();
    EXPECT_TRUE(waitUntil([&] { return isShown(row); })) << toTheLeft;
  }
}

TEST_F(TurnedWindow, MovesTheButtonsOfAnOpenPopup) {
  auto* popup = new app_assist::WPopupController;
  popup->setContent("Text");
  popup->addButton("Cancel", nullptr);
  popup->addButton("OK", nullptr);
  pushed("page")->attachPopup(popup);
  Evas_Object* cancel = elm_object_part_content_get(popup->getEvasObj(), "button1");
  Evas_Object* ok = elm_object_part_content_get(popup->getEvasObj(), "button2");
  ASSERT_TRUE(waitUntil([&] { return leftOf(cancel) < leftOf(ok); }));
  turn(true);
  EXPECT_TRUE(waitUntil([&] { return leftOf(cancel) > leftOf(ok); }));
  turn(false);
  EXPECT_TRUE(waitUntil([&] { return leftOf(cancel) < leftOf(ok); }));
}
