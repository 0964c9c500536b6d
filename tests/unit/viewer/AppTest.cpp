#include <app_control.h>
#include <system_settings.h>

#include <algorithm>

#include "PageTest.h"
#include "ZQVReceiverView.h"

namespace {

constexpr const char* kLaunch = "http://tizen.org/appcontrol/operation/launch_viewer";
constexpr long long kNow = 1700000000;

/// A launch request, as the platform hands it over.
class Request {
 public:
  explicit Request(const char* operation = kLaunch) {
    app_control_create(&_handle);
    app_control_set_operation(_handle, operation);
  }
  ~Request() { app_control_destroy(_handle); }
  Request(const Request&) = delete;
  Request& operator=(const Request&) = delete;

  Request& with(const char* key, const char* value) {
    app_control_add_extra_data(_handle, key, value);
    return *this;
  }
  Request& with(const char* key, std::vector<const char*> values) {
    app_control_add_extra_data_array(_handle, key, values.data(), static_cast<int>(values.size()));
    return *this;
  }
  void send() { TestViewer::get().onAppControl(_handle); }

 private:
  app_control_h _handle = nullptr;
};

class LaunchRequest : public PageTest {
 protected:
  void SetUp() override {
    PageTest::SetUp();
    platform().now = kNow;
    FakeShare share;
    share.expiry = kNow * 1000 + 5000;
    share.files = {FakeFile(), FakeFile(), FakeFile()};
    for (size_t i = 0; i < 3; ++i) {
      share.files[i].name = "file" + std::to_string(i) + ".jpg";
      share.files[i].url = "http://s/file/" + std::to_string(i);
      share.files[i].thumb = "http://s/thumb/" + std::to_string(i);
      share.files[i].mid = "http://s/mid/" + std::to_string(i);
    }
    platform().received["good"] = share;
    share.expiry = kNow * 1000 - 1;
    platform().received["expired"] = share;
    FakeShare sent;
    sent.recipients = {"+8210"};
    FakeFile local;
    local.path = "/opt/usr/media/a.jpg";
    sent.files = {local, local};
    platform().sent[7] = sent;
    platform().files["/opt/usr/media/a.jpg"] = 10;
    platform().mimeTypes["jpg"] = "image/jpeg";
  }
  static void received(const char* token) {
    Request().with("view_type", "received").with("contents_token", token).send();
  }
  std::string summary() const {
    return textOf(elm_object_part_content_get(top()->getEvasObj(), "elm.swallow.label.text"));
  }
  unsigned int cells() const {
    return elm_gengrid_items_count(
        elm_object_part_content_get(top()->getEvasObj(), "elm.swallow.gengrid.layout"));
  }
};

TEST_F(LaunchRequest, ForAReceivedShareShowsTheReceiverPage) {
  received("good");
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
  EXPECT_EQ(title(), "From +821011112222");
  EXPECT_EQ(cells(), 3u);
  EXPECT_EQ(platform().downloads.size(), 2u);
  EXPECT_EQ(platform().usageRecords, 1);
}

TEST_F(LaunchRequest, WithATokenAloneIsForAReceivedShare) {
  Request().with("contents_token", "good").send();
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
  EXPECT_EQ(platform().usageRecords, 1);
}

TEST_F(LaunchRequest, ForAnExpiredShareShowsTheExpiredPageOnly) {
  received("expired");
  EXPECT_EQ(pages(), Errors({"ZQVExpiredView"}));
  EXPECT_TRUE(platform().downloads.empty());
}

TEST_F(LaunchRequest, InTheSecondOfTheExpiryIsInTime) {
  platform().received["good"].expiry = kNow * 1000;
  received("good");
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
  platform().received["good"].expiry = kNow * 1000 - 1;
  received("good");
  EXPECT_EQ(pages(), Errors({"ZQVExpiredView"}));
}

TEST_F(LaunchRequest, ForASentShareShowsTheSenderPage) {
  Request().with("view_type", "sent").with("request_id", "7").send();
  EXPECT_EQ(pages(), Errors({"ZQVSenderView"}));
  EXPECT_EQ(platform().usageRecords, 1);
}

TEST_F(LaunchRequest, WithFilesShowsTheSenderPage) {
  Request().with("freemsg_send_data", {"/opt/usr/media/a.jpg", "/no/such/file.jpg"}).send();
  EXPECT_EQ(pages(), Errors({"ZQVSenderView"}));
  EXPECT_EQ(elm_object_item_part_content_get(topItem(), "toolbar"), nullptr);
}

TEST_F(LaunchRequest, WithNothingShowsAnEmptySenderPage) {
  Request().send();
  EXPECT_EQ(pages(), Errors({"ZQVSenderView"}));
}

TEST_F(LaunchRequest, ReplacesWhatWasShown) {
  received("good");
  Request().with("view_type", "sent").with("request_id", "7").send();
  EXPECT_EQ(pages(), Errors({"ZQVSenderView"}));
  EXPECT_EQ(traces().back(), "eina_list_count(_thumbList):2");
  received("expired");
  EXPECT_EQ(pages(), Errors({"ZQVExpiredView"}));
}

TEST_F(LaunchRequest, EndsTheRefreshOfTheGridThatWasShown) {
  received("good");
  platform().downloads[0].arrive("/opt/usr/thumbnail/0.png", "http://s/thumb/0");
  Request().with("view_type", "sent").with("request_id", "7").send();
  FakeClock::advance(2);
  EXPECT_EQ(platform().gridRefreshes, 0);
}

TEST_F(LaunchRequest, IsNothingWithoutARequest) {
  TestViewer::get().onAppControl(nullptr);
  EXPECT_EQ(errors(), Errors({"request is NULL"}));
}

TEST_F(LaunchRequest, OfAnotherOperationChangesNothing) {
  received("good");
  FakeLog::get().clear();
  Request(APP_CONTROL_OPERATION_VIEW).with("view_type", "sent").send();
  Request(APP_CONTROL_OPERATION_DEFAULT).send();
  Request(nullptr).send();
  EXPECT_EQ(errors(), Errors({std::string("Invalid operation: ") + APP_CONTROL_OPERATION_VIEW,
                              std::string("Invalid operation: ") + APP_CONTROL_OPERATION_DEFAULT,
                              "Invalid operation: operation is NULL"}));
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
}

TEST_F(LaunchRequest, OfAnUnknownViewTypeLeavesNothing) {
  received("good");
  for (const char* type : {"Sent", "SENT", "received ", "x"}) {
    Request().with("view_type", type).with("contents_token", "good").send();
    EXPECT_EQ(errors().back(), "viewType error");
    EXPECT_TRUE(pages().empty());
  }
}

TEST_F(LaunchRequest, ForAnUnknownShareLowersTheWindow) {
  received("unknown");
  Request().with("view_type", "sent").with("request_id", "99").send();
  EXPECT_EQ(errors(), Errors(2, "Unexpected SAPI error(get SAPI handle failed)!"));
  EXPECT_EQ(platform().lowered, 2);
  EXPECT_TRUE(pages().empty());
  received("good");
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
}

TEST_F(LaunchRequest, WithoutTokenOrNumberIsForAnUnknownShare) {
  Request().with("view_type", "received").send();
  Request().with("view_type", "sent").send();
  Request().with("view_type", "sent").with("request_id", "no number").send();
  EXPECT_EQ(errors(), Errors(3, "Unexpected SAPI error(get SAPI handle failed)!"));
}

TEST_F(LaunchRequest, TakesExtrasOfTheWrongKindForMissing) {
  Request()
      .with("view_type", std::vector<const char*>{"received"})
      .with("contents_token", "good")
      .send();
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
  Request().with("freemsg_send_data", "/opt/usr/media/a.jpg").send();
  EXPECT_EQ(pages(), Errors({"ZQVSenderView"}));
}

TEST_F(LaunchRequest, SurvivesHugeAndBrokenTexts) {
  received(std::string(65536, 't').c_str());
  received("\xff\xfe");
  Request(std::string(65536, 'o').c_str()).send();
  Request().with("freemsg_send_data", {"\xff.jpg", std::string(5000, '/').c_str()}).send();
  EXPECT_EQ(pages(), Errors({"ZQVSenderView"}));
}

TEST_F(LaunchRequest, ShowsNothingForAShareThatTellsTooLittle) {
  platform().received["good"].sender.reset();
  received("good");
  platform().received["good"].sender = "+8210";
  platform().received["good"].countError = -5;
  received("good");
  platform().received["good"].countError = 0;
  platform().received["good"].expiryError = -5;
  received("good");
  EXPECT_EQ(errors(),
            Errors({"get sender msisdn failed!", "get count failed", "get expired time failed"}));
  EXPECT_TRUE(pages().empty());
}

TEST_F(LaunchRequest, CountsTheSizeOfFilesThatAreLeftOut) {
  auto& files = platform().received["good"].files;
  files[0].size = files[2].size = 1 << 20;
  files[1].size = 2 << 20;
  files[1].name.reset();
  received("good");
  EXPECT_EQ(cells(), 2u);
  EXPECT_NE(summary().find("2 files (4.00 MB)"), std::string::npos);
}

TEST_F(LaunchRequest, LogsFilesWithoutASize) {
  platform().received["good"].files[1].size = 0;
  received("good");
  EXPECT_EQ(errors()[0], "index : 1, fileSize is 0!");
  EXPECT_EQ(cells(), 2u);
}

TEST_F(LaunchRequest, ForASingleShareHasAHint) {
  Request()
      .with("share_type", "single_share")
      .with("view_type", "received")
      .with("contents_token", "good")
      .send();
  EXPECT_NE(summary().find("later these"), std::string::npos);
  Request().with("share_type", "Single_share").with("contents_token", "good").send();
  EXPECT_EQ(summary().find("later"), std::string::npos);
}

TEST_F(LaunchRequest, GoesOnWithoutRecipientsCountOrPath) {
  FakeShare& sent = platform().sent[7];
  sent.recipientsError = -5;
  sent.files[0].path.reset();
  Request().with("view_type", "sent").with("request_id", "7").send();
  EXPECT_EQ(errors()[0], "Unexpected SAPI error(get SAPI msisdn list failed)!");
  EXPECT_EQ(errors()[1], "Unexpected SAPI error(get SAPI file path failed)!");
  EXPECT_EQ(errors()[2], "arrayValue[0] is NULL");
  sent.recipientsError = 0;
  sent.countError = -5;
  FakeLog::get().clear();
  Request().with("view_type", "sent").with("request_id", "7").send();
  EXPECT_EQ(errors()[0], "Unexpected SAPI error(get SAPI count failed)!");
  EXPECT_EQ(pages(), Errors({"ZQVSenderView"}));
}

TEST_F(LaunchRequest, ShowsTheSendersContactName) {
  platform().contacts = {{"+821011112222", "Anna", {}}};
  received("good");
  EXPECT_EQ(title(), "From Anna");
  received("expired");
  EXPECT_EQ(title(), "From Anna");
}

class App : public LaunchRequest {
 protected:
  static void contactsChange() { viewer().contactsChanged("person", &viewer()); }
  static void settingChanges(int key) { viewer().settingsChanged(key, &viewer()); }
  static TestViewer& viewer() { return TestViewer::get(); }
};

TEST_F(App, WatchesThe24HourFormatTheClockAndTheLanguageInThisOrder) {
  EXPECT_EQ(viewer().watchedSettings, (std::vector<int>{14, 16, 13}));
}

TEST_F(App, StartsWithoutContacts) {
  const Errors& log = viewer().startErrors;
  EXPECT_EQ(std::count(log.begin(), log.end(), "contacts_connect failed : error = -33619791"), 1);
}

TEST_F(App, DoesNothingWhenItIsPausedOrResumed) {
  received("good");
  viewer().onPause();
  viewer().onResume();
  EXPECT_EQ(pages(), Errors({"ZQVReceiverView"}));
}

TEST_F(App, EndsWhenItsLastPageIsPopped) {
  received("good");
  naviframe.pop();
  EXPECT_TRUE(waitUntil([] { return platform().exits > 0; }));
  EXPECT_EQ(platform().exits, 1);
}

TEST_F(App, EndsWhenTheBackButtonOfItsOnlyPageIsPressed) {
  received("expired");
  click(elm_object_item_part_content_get(topItem(), "prev_btn"));
  EXPECT_TRUE(waitUntil([] { return platform().exits > 0; }));
}

TEST_F(App, ShowsANewContactNameWithoutARelaunch) {
  received("good");
  platform().contacts = {{"+821011112222", "Anna", {}}};
  contactsChange();
  EXPECT_EQ(title(), "From Anna");
  platform().contacts.clear();
  contactsChange();
  EXPECT_EQ(title(), "From +821011112222");
}

TEST_F(App, ShowsANewContactNameOnEveryPage) {
  received("good");
  click(toolbarButton());
  platform().contacts = {{"+821011112222", "Anna", {}}};
  contactsChange();
  auto* receiver = static_cast<ZQVReceiverView*>(
      elm_object_item_data_get(elm_naviframe_bottom_item_get(naviframe.getEvasObj())));
  EXPECT_STREQ(receiver->getTitle(), "From Anna");
}

TEST_F(App, ShowsANewContactNameOfASentAndAnExpiredShare) {
  Request().with("view_type", "sent").with("request_id", "7").send();
  contactsChange();
  received("expired");
  platform().contacts = {{"+821011112222", "Anna", {}}};
  contactsChange();
  EXPECT_EQ(title(), "From Anna");
}

TEST_F(App, NeedsToKnowItself) {
  viewer().contactsChanged("person", nullptr);
  viewer().settingsChanged(13, nullptr);
  EXPECT_EQ(errors(), Errors({"Invalid Param : data", "data is null!"}));
}

TEST_F(App, StopsAtAPageWithoutAView) {
  received("good");
  Evas_Object* content = elm_layout_add(naviframe.getEvasObj());
  Elm_Object_Item* stranger =
      elm_naviframe_item_push(naviframe.getEvasObj(), "x", nullptr, nullptr, content, nullptr);
  contactsChange();
  EXPECT_EQ(errors(), Errors({"view is null!"}));
  elm_object_item_del(stranger);
}

TEST_F(App, ShowsTextsAnewForTheLanguageOnly) {
  received("good");
  platform().regionFormat = "en_US";
  settingChanges(14);
  settingChanges(16);
  EXPECT_NE(summary().find("14/11/2023"), std::string::npos);
  settingChanges(13);
  EXPECT_NE(summary().find("11/14/2023"), std::string::npos);
}

TEST_F(App, DoesNothingForASettingWithoutPages) {
  settingChanges(13);
  contactsChange();
  EXPECT_TRUE(errors().empty());
}

class NoClassName : public app_assist::WContentViewController {
 public:
  explicit NoClassName(const char* name) : _name(name) {}
  const char* getClassName() override { return _name; }
  Evas_Object* onCreateView(Evas_Object* parent, void*) override { return elm_layout_add(parent); }

 private:
  const char* _name;
};

TEST_F(App, PassesAPageOfAnotherKind) {
  naviframe.push(new NoClassName("Another"));
  contactsChange();
  EXPECT_TRUE(errors().empty());
}

TEST_F(App, StopsAtAPageWithoutAName) {
  naviframe.push(new NoClassName(nullptr));
  settingChanges(13);
  EXPECT_EQ(errors(), Errors({"className is null!"}));
}

}  // namespace
