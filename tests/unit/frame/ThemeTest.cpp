/// The toolkit says nothing when a style or a part is missing, so this does.
#include <Ecore_Evas.h>
#include <Edje.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <ostream>
#include <sstream>
#include <string>

#include "DeviceTheme.h"

namespace {

/// A group and the parts that programs put something into, apart by blanks.
struct Group {
  const char* name;
  const char* parts;
};

std::ostream& operator<<(std::ostream& out, const Group& group) {
  return out << group.name;
}

const Group kViewerGroups[] = {
    {"receiver_viewer_shared_file_thumbnail_layout_2line",
     "elm.swallow.label.text elm.swallow.gengrid.layout"},
    {"receiver_viewer_shared_file_thumbnail_layout_4line",
     "elm.swallow.label.text elm.swallow.gengrid.layout"},
    {"viewer_select_thumbnail_layout", "elm.swallow.recipient.text elm.swallow.gengrid.layout"},
    {"sender_viewer_shared_file_thumbnail_layout",
     "elm.swallow.recipient.text elm.swallow.gengrid.layout"},
    {"expired_viewer_shared_file_thumbnail_layout",
     "elm.swallow.label.text elm.swallow.label.message"},
    {"processing_view_layout", "processing elm.text"},
    {"popup_checkview_layout", "elm.swallow.end elm.swallow.check"},
    {"layout/naviframe/title_right", "content"},
    {"griditem",
     "default_thumbnail thumbnail logo filename playicon playiconBG playiconEF downstatus"},
    {"fullgriditem", "default_thumbnail thumbnail logo logo_bg filename filesize"},
    {"fullgriditem_video", "default_thumbnail thumbnail playicon playiconBG playiconEF"},
};

const Group kDeviceGroups[] = {
    {"elm/layout/phone/window", "elm.swallow.content clock battery network message"},
    {"elm/layout/phone/message", "elm.text"},
    {"elm/border/base/default", "elm.swallow.client elm.spacer.content elm.rect.background"},
    {"elm/naviframe/item/basic/default",
     "elm.text.title elm.swallow.prev_btn elm.swallow.content toolbar title_left_btn "
     "title_right_btn"},
    {"elm/naviframe/item/fullview/default",
     "elm.text.title elm.swallow.prev_btn elm.swallow.content toolbar title_right_btn"},
    {"elm/button/base/default", "elm.text elm.swallow.content"},
    {"elm/button/base/naviframe/end_btn/default", "elm.swallow.content"},
    {"elm/button/base/bottom", "elm.text elm.swallow.content"},
    {"elm/button/base/naviframe/title_right", "elm.text elm.swallow.content"},
    {"elm/button/base/naviframe/title_left", "elm.text elm.swallow.content"},
    {"elm/button/base/popup/default", "elm.text elm.swallow.content"},
    {"elm/label/base/default", "elm.text"},
    {"elm/label/base/popup/default", "elm.text"},
    {"elm/gengrid/base/default", "elm.swallow.content elm.dragable.vbar elm.dragable.hbar"},
    {"elm/gengrid/base/no_effect", "elm.swallow.content elm.dragable.vbar elm.dragable.hbar"},
    {"elm/genlist/base/default", "elm.swallow.content elm.dragable.vbar elm.dragable.hbar"},
    {"elm/scroller/base/default", "elm.swallow.content elm.dragable.vbar elm.dragable.hbar"},
    {"elm/gengrid/item/default/default", "elm.swallow.icon elm.swallow.end"},
    {"elm/gengrid/item/default/no_effect", "elm.swallow.icon elm.swallow.end"},
    {"elm/genlist/item/1line/default", "elm.text.main.left elm.text.main elm.icon.1 elm.icon.2"},
    {"elm/genlist/item_compress/1line/default",
     "elm.text.main.left elm.text.main elm.icon.1 elm.icon.2"},
    {"elm/genlist/item/group_index/default", "elm.text"},
    {"elm/genlist/item_compress/group_index/default", "elm.text"},
    {"elm/check/base/default", "elm.text"},
    {"elm/check/base/list", ""},
    {"elm/check/base/popup", "elm.text"},
    {"elm/progressbar/horizontal/default", "elm.swallow.bar elm.cur.progressbar"},
    {"elm/progressbar/horizontal/process_medium", "elm.swallow.bar elm.cur.progressbar"},
    {"elm/layout/list/C/type.1/default", "elm.swallow.content"},
    {"elm/layout/list/B/type.2/default", "elm.swallow.content"},
    {"elm/popup/base/default", "elm.text.title elm.swallow.content elm.swallow.action_area"},
    {"elm/popup/buttons1/popup/default", "elm.swallow.content.button1"},
    {"elm/popup/buttons2/popup/default", "elm.swallow.content.button1 elm.swallow.content.button2"},
    {"elm/popup/buttons3/popup/default",
     "elm.swallow.content.button1 elm.swallow.content.button2 elm.swallow.content.button3"},
    {"elm/notify/bottom/popup/default", "elm.swallow.content"},
    {"elm/notify/block_events/popup/default", ""},
};

/// An object of a group, on a canvas that nobody sees.
class Drawn {
 public:
  Drawn(const std::string& file, const char* group)
      : _canvas(ecore_evas_buffer_new(720, 1280)),
        object(edje_object_add(ecore_evas_get(_canvas))),
        loaded(edje_object_file_set(object, file.c_str(), group)) {}
  ~Drawn() { ecore_evas_free(_canvas); }

  /// ARGB.
  unsigned pixelInTheMiddle() {
    ecore_evas_show(_canvas);
    evas_object_resize(object, 720, 1280);
    evas_object_show(object);
    ecore_evas_manual_render(_canvas);
    return static_cast<const unsigned*>(ecore_evas_buffer_pixels_get(_canvas))[640 * 720 + 360];
  }

 private:
  Ecore_Evas* const _canvas;

 public:
  Evas_Object* const object;
  const bool loaded;
};

void expectParts(const std::string& file, const Group& group) {
  const Drawn drawn(file, group.name);
  ASSERT_TRUE(drawn.loaded) << "no group " << group.name;
  std::istringstream parts(group.parts);
  for (std::string part; parts >> part;) {
    EXPECT_TRUE(edje_object_part_exists(drawn.object, part.c_str())) << part;
  }
}

std::string itemOf(const std::string& file, const std::string& group, const char* key) {
  const Drawn drawn(file, group.c_str());
  const char* value = edje_object_data_get(drawn.object, key);
  return value ? value : "";
}

class ViewerTheme : public testing::TestWithParam<Group> {};
class DeviceThemeGroups : public testing::TestWithParam<Group> {};

std::string deviceTheme() {
  return app_assist::DeviceTheme::path();
}

std::string nameOf(const testing::TestParamInfo<Group>& info) {
  std::string name(info.param.name);
  for (char& letter : name) {
    if (!isalnum(static_cast<unsigned char>(letter))) letter = '_';
  }
  return name;
}

}  // namespace

TEST_P(ViewerTheme, HasTheGroupWithAllItsParts) {
  expectParts(EDJE_DIR "/remote_share_viewer.edj", GetParam());
}
INSTANTIATE_TEST_SUITE_P(Groups, ViewerTheme, testing::ValuesIn(kViewerGroups), nameOf);

TEST_P(DeviceThemeGroups, HasTheGroupWithAllItsParts) {
  expectParts(deviceTheme(), GetParam());
}
INSTANTIATE_TEST_SUITE_P(Groups, DeviceThemeGroups, testing::ValuesIn(kDeviceGroups), nameOf);

TEST(DeviceTheme, AsksCellsAndRowsForWhatItShows) {
  EXPECT_EQ(itemOf(deviceTheme(), "elm/gengrid/item/default/default", "contents"),
            "elm.swallow.icon elm.swallow.end");
  EXPECT_EQ(itemOf(deviceTheme(), "elm/genlist/item_compress/1line/default", "contents"),
            "elm.icon.1 elm.icon.2");
  EXPECT_NE(itemOf(deviceTheme(), "elm/genlist/item_compress/1line/default", "texts")
                .find("elm.text.main.left"),
            std::string::npos);
  EXPECT_EQ(
      itemOf(deviceTheme(), "elm/genlist/item_compress/group_index/default", "texts").substr(0, 8),
      "elm.text");
}

TEST(DeviceTheme, LetsAPopupBeDismissed) {
  for (const char* group :
       {"elm/notify/bottom/popup/default", "elm/notify/block_events/popup/default"}) {
    EXPECT_EQ(itemOf(deviceTheme(), group, "hide_finished_signal"), "on") << group;
  }
}

TEST(DeviceTheme, HasEveryColourInBothPalettes) {
  char* names = edje_file_data_get(deviceTheme().c_str(), "colours");
  ASSERT_TRUE(names);
  std::istringstream list(names);
  free(names);
  int count = 0;
  for (std::string name; list >> name; count++) {
    for (const char* palette : {"light/", "dark/"}) {
      char* value = edje_file_data_get(deviceTheme().c_str(), (palette + name).c_str());
      int r, g, b, a;
      EXPECT_TRUE(value && sscanf(value, "%d %d %d %d", &r, &g, &b, &a) == 4) << palette << name;
      free(value);
    }
  }
  EXPECT_GT(count, 10);
}

TEST(DeviceTheme, LetsTheApplicationColourTheGroundOfGridsAndScrollers) {
  for (const char* group :
       {"elm/gengrid/base/default", "elm/gengrid/base/no_effect", "elm/scroller/base/default"}) {
    Drawn drawn(deviceTheme(), group);
    edje_object_color_class_set(drawn.object, "transparent", 200, 100, 50, 255, 0, 0, 0, 0, 0, 0, 0,
                                0);
    EXPECT_EQ(drawn.pixelInTheMiddle(), 0xffc86432u) << group;
  }
}
