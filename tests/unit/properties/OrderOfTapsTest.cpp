#include <libintl.h>
#include <rapidcheck.h>

#include <cstring>

#include "../views/ViewTest.h"
#include "WGenlistItemMonoline1Check.h"
#include "ZQVRows.h"
#include "ZQVSelectView.h"

// A catalogue of one message, so that the title tells the count.
extern "C" char* dgettext(const char*, const char* id) noexcept {
  const bool isCount = strcmp(id, "IDS_RSH_HEADER_PD_SELECTED_ABB") == 0;
  return const_cast<char*>(isCount ? "%d selected" : id);
}

namespace {

/// Instead of the number of a file.
constexpr int kSelectAll = -1;

/// The select page of some files, for as long as this is.
class OpenPage {
 public:
  OpenPage(app_assist::WNaviframeController& naviframe, const Items& files)
      : _naviframe(naviframe), _view(new ZQVSelectView(files.list(), "Minji", "token")) {
    naviframe.push(_view);
    _grid = elm_object_part_content_get(_view->getEvasObj(), "elm.swallow.gengrid.layout");
    _list = elm_object_part_content_get(_view->getEvasObj(), "elm.swallow.recipient.text");
  }
  ~OpenPage() {
    _naviframe.destroyAllViewControllers();
    // The canvas keeps what was deleted until it draws the next time.
    evas_norender(evas_object_evas_get(_naviframe.getEvasObj()));
  }
  OpenPage(const OpenPage&) = delete;
  OpenPage& operator=(const OpenPage&) = delete;

  void tap(ZQViewerThumbnailItem& file) {
    ZQVSelectView::_gridItemCb(_view, _grid, file.gridItems[ZQV_VIEW_SELECT]);
  }
  void tapAll() { ZQVSelectView::_listItemCb(_view, _list, row()); }

  bool isAllChecked() const {
    return zqvRowOf<WGenlistItemMonoline1Check>(elm_object_item_data_get(row()))->isChecked();
  }
  bool isDoneEnabled() const {
    return !elm_object_disabled_get(
        elm_object_item_part_content_get(_view->getNaviItem(), "title_right_btn"));
  }
  std::string title() const { return elm_object_item_text_get(_view->getNaviItem()); }

 private:
  Elm_Object_Item* row() const { return elm_genlist_first_item_get(_list); }

  app_assist::WNaviframeController& _naviframe;
  ZQVSelectView* _view;
  Evas_Object* _grid = nullptr;
  Evas_Object* _list = nullptr;
};

std::string titleFor(int count) {
  return count < 1 ? zqvText("IDS_RSH_HEADER_SELECT_ITEMS_ABB3")
                   : zqvFormat("IDS_RSH_HEADER_PD_SELECTED_ABB", "d", count);
}

/// Which files are checked after a tap.
void follow(int tapped, bool allChecked, const Items& files, std::vector<bool>* checks) {
  for (size_t i = 0; i < files.size(); ++i) {
    if (!files[i].gridItems[ZQV_VIEW_SELECT]) continue;
    if (tapped == kSelectAll) (*checks)[i] = !allChecked;
    if (tapped == static_cast<int>(i)) (*checks)[i] = !(*checks)[i];
  }
}

void requireAgreement(const OpenPage& page, const Items& files, const std::vector<bool>& checks) {
  int selectable = 0;
  int count = 0;
  for (size_t i = 0; i < files.size(); ++i) {
    RC_ASSERT(files[i].checked == checks[i]);
    selectable += files[i].gridItems[ZQV_VIEW_SELECT] != nullptr;
    count += checks[i];
  }
  RC_ASSERT(page.title() == titleFor(count));
  // Over no files at all the two follow the taps on select-all.
  if (selectable == 0) {
    RC_ASSERT(page.isDoneEnabled() == page.isAllChecked());
    return;
  }
  RC_ASSERT(page.isAllChecked() == (count == selectable));
  RC_ASSERT(page.isDoneEnabled() == (count > 0));
}

using OrderOfTaps = ViewTest;

}  // namespace

TEST_F(OrderOfTaps, KeepsCountChecksAndSelectAllInAgreement) {
  EXPECT_TRUE(rc::check([this] {
    Items files;
    for (const int status : *rc::gen::container<std::vector<int>>(
             rc::gen::elementOf(std::vector<int>{0, 0, 0, 1, 2, 3}))) {
      files.add("a.jpg", 1).downloadStatus = status;
    }
    std::vector<bool> checks(files.size());
    const int last = static_cast<int>(files.size());
    const auto taps = *rc::gen::container<std::vector<int>>(rc::gen::inRange(kSelectAll, last));
    OpenPage page(naviframe, files);
    requireAgreement(page, files, checks);
    for (const int tapped : taps) {
      follow(tapped, page.isAllChecked(), files, &checks);
      if (tapped == kSelectAll) {
        page.tapAll();
      } else if (files[static_cast<size_t>(tapped)].gridItems[ZQV_VIEW_SELECT]) {
        page.tap(files[static_cast<size_t>(tapped)]);
      }
      requireAgreement(page, files, checks);
    }
  }));
}
