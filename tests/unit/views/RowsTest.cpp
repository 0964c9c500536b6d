#include <unistd.h>

#include <fstream>

#include "ViewTest.h"
#include "WGenlistItemGroup.h"
#include "WGenlistItemMonoline1Check.h"
#include "WGenlistItemMonoline1Icon.h"
#include "ZQVContacts.h"
#include "ZQVRows.h"

class Rows : public ViewTest {
 protected:
  Rows() : list(elm_genlist_add(TestApp::get().window())) {}
  ~Rows() override { evas_object_del(list); }

  std::string text(app_assist::WGenlistItem& row, const char* part) {
    char* text = row.getItemClass()->func.text_get(&row, list, part);
    std::string copy = text ? text : "(null)";
    free(text);
    return copy;
  }
  Evas_Object* content(app_assist::WGenlistItem* row, Elm_Genlist_Item_Class* rowClass,
                       const char* part) {
    return rowClass->func.content_get ? rowClass->func.content_get(row, list, part) : nullptr;
  }
  /// The picture inside an icon row's content.
  Evas_Object* picture(const char* path) {
    WGenlistItemMonoline1Icon row("Minji", path);
    Evas_Object* layout = content(&row, row.getItemClass(), "elm.icon.1");
    return elm_object_part_content_get(layout, "elm.swallow.content");
  }
  static std::string fileOf(Evas_Object* image) {
    const char* file = nullptr;
    elm_image_file_get(image, &file, nullptr);
    return file ? file : "";
  }

  Evas_Object* list;
};

TEST_F(Rows, AnswerOnlyForTheirTextParts) {
  WGenlistItemMonoline monoline("plain");
  WGenlistItemGroup group("plain");
  for (const char* part : {"elm.text.main.left", "elm.text.main", "elm.text"}) {
    EXPECT_EQ(text(monoline, part), "plain") << part;
    EXPECT_EQ(text(group, part), "plain") << part;
  }
  EXPECT_EQ(text(monoline, "elm.text.sub"), "(null)");

  WGenlistItemMonoline1Icon icon("plain", nullptr);
  WGenlistItemMonoline1Check check("plain");
  for (const char* part : {"elm.text.main.left", "elm.text.main"}) {
    EXPECT_EQ(text(icon, part), "plain") << part;
    EXPECT_EQ(text(check, part), "plain") << part;
  }
  EXPECT_EQ(text(icon, "elm.text"), "(null)");
  EXPECT_EQ(text(check, "elm.text"), "(null)");
}

TEST_F(Rows, TranslateMessageIds) {
  WGenlistItemMonoline1Check check("IDS_RSH_OPT_SELECT_ALL");
  EXPECT_EQ(text(check, "elm.text.main"), zqvText("IDS_RSH_OPT_SELECT_ALL"));
}

TEST_F(Rows, GiveNullForANullText) {
  WGenlistItemMonoline monoline(nullptr);
  WGenlistItemMonoline1Check check(nullptr);
  EXPECT_EQ(text(monoline, "elm.text"), "(null)");
  EXPECT_EQ(text(check, "elm.text.main"), "(null)");
}

TEST_F(Rows, HaveTheirStylesAndShareOneClassPerKind) {
  WGenlistItemMonoline a("a");
  WGenlistItemMonoline b("b");
  WGenlistItemGroup group("g");
  WGenlistItemMonoline1Icon icon("i", nullptr);
  WGenlistItemMonoline1Check check("c");
  EXPECT_STREQ(a.getItemClass()->item_style, "1line");
  EXPECT_STREQ(group.getItemClass()->item_style, "group_index");
  EXPECT_STREQ(icon.getItemClass()->item_style, "1line");
  EXPECT_STREQ(check.getItemClass()->item_style, "1line");
  EXPECT_EQ(a.getItemClass(), b.getItemClass());
  EXPECT_NE(a.getItemClass(), group.getItemClass());
  EXPECT_EQ(a.getItemClass()->func.content_get, nullptr);
  EXPECT_STREQ(a.getClassName(), "WGenlistItemMonoline");
  EXPECT_STREQ(group.getClassName(), "WGenlistItemGroup");
  EXPECT_EQ(group.onWrap(&group), &group);
}

TEST_F(Rows, ShowTheDefaultPictureForNoPicture) {
  EXPECT_EQ(fileOf(picture(nullptr)), ZQV_DEFAULT_CALLER_IMAGE);
  EXPECT_EQ(fileOf(picture("")), ZQV_DEFAULT_CALLER_IMAGE);
}

TEST_F(Rows, ShowTheDrawnPicturesAsTheyAre) {
  EXPECT_EQ(fileOf(picture(ZQV_DEFAULT_CALLER_IMAGE)), ZQV_DEFAULT_CALLER_IMAGE);
  EXPECT_EQ(fileOf(picture(ZQV_GROUP_CALLER_IMAGE)), ZQV_GROUP_CALLER_IMAGE);
}

TEST_F(Rows, ShowTheDefaultPictureForAPhotoThatCannotBeRead) {
  const std::string broken = testing::TempDir() + "zelqo-broken.png";
  std::ofstream(broken) << "no picture";
  EXPECT_EQ(fileOf(picture(broken.c_str())), ZQV_DEFAULT_CALLER_IMAGE);
  EXPECT_EQ(fileOf(picture("/nowhere/photo.png")), ZQV_DEFAULT_CALLER_IMAGE);
  remove(broken.c_str());
}

TEST_F(Rows, MaskAPhotoTo74Pixels) {
  if (access(ZQV_IMAGE_DIR, R_OK) != 0) GTEST_SKIP() << "the mask lies on the phone";
  const char* photo = ZQV_IMAGE_DIR "fileicon/148x148/zq_file_full_ic_img.png";
  Evas_Object* image = picture(photo);
  ASSERT_NE(fileOf(image), ZQV_DEFAULT_CALLER_IMAGE);
  int width = 0;
  int height = 0;
  evas_object_image_size_get(elm_image_object_get(image), &width, &height);
  EXPECT_EQ(width, 74);
  EXPECT_EQ(height, 74);
}

TEST_F(Rows, HaveNoPictureInOtherParts) {
  WGenlistItemMonoline1Icon row("Minji", nullptr);
  EXPECT_EQ(content(&row, row.getItemClass(), "elm.icon.2"), nullptr);
  EXPECT_EQ(content(nullptr, row.getItemClass(), "elm.icon.1"), nullptr);
}

TEST_F(Rows, HaveALayoutWithoutACheckForNoRow) {
  WGenlistItemMonoline1Check row("text");
  EXPECT_EQ(content(&row, row.getItemClass(), "elm.icon.1"), nullptr);
  Evas_Object* layout = content(nullptr, row.getItemClass(), "elm.icon.2");
  ASSERT_NE(layout, nullptr);
  EXPECT_EQ(elm_object_part_content_get(layout, "elm.swallow.content"), nullptr);
}

TEST_F(Rows, TurnATapOnTheCheckIntoATapOnTheRow) {
  auto* row = new WGenlistItemMonoline1Check("text");
  int taps = 0;
  Elm_Object_Item* item = zqvAppendRow(
      list, row, [](void* data, Evas_Object*, void*) { ++*static_cast<int*>(data); }, &taps);
  Evas_Object* layout = content(row, row->getItemClass(), "elm.icon.2");
  Evas_Object* check = elm_object_part_content_get(layout, "elm.swallow.content");
  ASSERT_NE(check, nullptr);
  EXPECT_FALSE(elm_check_state_get(check));

  elm_check_state_set(check, EINA_TRUE);
  evas_object_smart_callback_call(check, "changed", nullptr);
  EXPECT_FALSE(elm_check_state_get(check)) << "the row's handler decides about the check";
  EXPECT_EQ(taps, 1);
  EXPECT_TRUE(elm_genlist_item_selected_get(item));
}
