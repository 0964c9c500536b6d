#include <system_settings.h>

#include "PageTest.h"
#include "ZQVExpiredView.h"

namespace {

class ExpiredView : public PageTest {
 protected:
  void show(const char* sender = "Anna", int count = 2, uint64_t expiry = 1700000000000) {
    view = new ZQVExpiredView(3 << 20, expiry, count, sender);
    naviframe.push(view);
  }
  static std::string summaryOf(int count, uint64_t expiry, uint64_t size = 3 << 20) {
    return taken(ZQVExpiredView(size, expiry, count, "x").getSummaryText());
  }
  std::string label(const char* part) const {
    Evas_Object* layout = elm_object_content_get(view->getEvasObj());
    return textOf(elm_object_part_content_get(layout, part));
  }

  ZQVExpiredView* view = nullptr;
};

TEST_F(ExpiredView, SaysWhoSharedWhatAndThatItHasExpired) {
  show();
  EXPECT_STREQ(view->getClassName(), "ZQVExpiredView");
  EXPECT_EQ(title(), "From Anna");
  EXPECT_EQ(label("elm.swallow.label.text"),
            "<font_size=28><color=#C0C0C0>2 files (3.00 MB)<br>until 14/11/2023</color>"
            "</font_size>");
  EXPECT_EQ(label("elm.swallow.label.message"),
            "<font_size=32><color=#000000><align=center>It has expired</align></color>"
            "</font_size>");
  EXPECT_TRUE(errors().empty());
}

TEST_F(ExpiredView, TakesTheExpiryInSecondsOrMilliseconds) {
  EXPECT_EQ(summaryOf(2, 1700000000000), summaryOf(2, 1700000000));
}

TEST_F(ExpiredView, KeepsTheFirstTenDigitsOfAnyExpiry) {
  EXPECT_EQ(summaryOf(2, 17000000009999), "2 files (3.00 MB)<br>until 14/11/2023");
  EXPECT_EQ(summaryOf(2, 0), "2 files (3.00 MB)<br>until 01/01/1970");
  EXPECT_EQ(summaryOf(2, UINT64_MAX), "2 files (3.00 MB)<br>until 15/06/2028");
}

TEST_F(ExpiredView, UsesTheSingularForOneFileOnly) {
  EXPECT_EQ(summaryOf(1, 1700000000), "1 file (3.00 MB)<br>until 14/11/2023");
  EXPECT_EQ(summaryOf(0, 1700000000), "0 files (3.00 MB)<br>until 14/11/2023");
  EXPECT_EQ(summaryOf(1, 1700000000, 0), "1 file (0.00 B)<br>until 14/11/2023");
}

TEST_F(ExpiredView, HasNoTitleWithoutASender) {
  show("");
  EXPECT_EQ(title(), "");
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  EXPECT_EQ(title(), "");
}

TEST_F(ExpiredView, ShowsTheSendersNameAsItIs) {
  show("<&>");
  EXPECT_EQ(title(), "From &lt;&amp;&gt;");
}

TEST_F(ExpiredView, KeepsItsDownloadButtonDisabled) {
  show();
  ASSERT_NE(toolbarButton(), nullptr);
  EXPECT_EQ(textOf(toolbarButton()), "Download");
  EXPECT_TRUE(elm_object_disabled_get(toolbarButton()));
  click(toolbarButton());
  EXPECT_EQ(pages(), Errors({"ZQVExpiredView"}));
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  EXPECT_TRUE(elm_object_disabled_get(toolbarButton()));
  EXPECT_EQ(textOf(toolbarButton()), "Download");
}

TEST_F(ExpiredView, ShowsItsTextsAnewWhenTheLanguageChanges) {
  show();
  view->setName("Berta");
  view->update(SYSTEM_SETTINGS_KEY_TIME_CHANGED);
  EXPECT_EQ(title(), "From Anna");
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  EXPECT_EQ(title(), "From Berta");
}

TEST_F(ExpiredView, LogsWhatIsMissing) {
  show();
  ZQVExpiredView::_backTitleButtonPressedCb(nullptr, nullptr, nullptr);
  evas_object_del(elm_object_item_part_content_unset(topItem(), "toolbar"));
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  elm_object_item_part_content_set(topItem(), "toolbar", elm_button_add(window));
  view->update(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE);
  EXPECT_EQ(errors(),
            Errors({"data is NULL", "toolbar part object is null!", "button text is null!"}));
  ZQVExpiredView alone(0, 0, 0, nullptr);
  EXPECT_EQ(alone.onCreateView(nullptr, nullptr), nullptr);
  EXPECT_EQ(errors().back(), "parent is NULL");
}

}  // namespace
