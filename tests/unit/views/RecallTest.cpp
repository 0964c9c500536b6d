#include <gio/gio.h>
#include <unistd.h>

#include "HistorySignal.h"
#include "ViewTest.h"
#include "ZQVSenderView.h"

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

constexpr int kLanguageChanged = 13;
constexpr const char* kAddress = "DBUS_SYSTEM_BUS_ADDRESS";

/// What anybody on the system bus hears of recalls.
class History {
 public:
  History() {
    const auto flags =
        static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                          G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION);
    _bus =
        g_dbus_connection_new_for_address_sync(getenv(kAddress), flags, nullptr, nullptr, nullptr);
    EXPECT_NE(_bus, nullptr);
    _subscription = g_dbus_connection_signal_subscribe(
        _bus, nullptr, "org.tizen.call.remote.share", nullptr, "/com/orlant/remoteshare", nullptr,
        G_DBUS_SIGNAL_FLAGS_NONE, _signalCb, this, nullptr);
    settle();
  }
  ~History() {
    g_dbus_connection_signal_unsubscribe(_bus, _subscription);
    g_dbus_connection_close_sync(_bus, nullptr, nullptr);
    g_object_unref(_bus);
  }
  /// After a round trip everything that was on the bus before has arrived.
  void settle() {
    g_autoptr(GVariant) answer = g_dbus_connection_call_sync(
        _bus, "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus", "GetId",
        nullptr, nullptr, G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr);
    EXPECT_NE(answer, nullptr);
    while (g_main_context_iteration(nullptr, FALSE)) {
    }
  }

  std::vector<std::string> heard;

 private:
  static void _signalCb(GDBusConnection*, const gchar*, const gchar*, const gchar*,
                        const gchar* member, GVariant* parameters, gpointer data) {
    g_autofree char* body = g_variant_print(parameters, FALSE);
    static_cast<History*>(data)->heard.push_back(std::string(member) + " " + body);
  }

  GDBusConnection* _bus = nullptr;
  guint _subscription = 0;
};

}  // namespace

void sendHistorySignalAndEnd() {
  const int result = ZQVSenderView::_sendDbusSignalToHistory(nullptr, "recall", "default");
  _exit(result == 0 ? 0 : 1);
}

class Recall : public ViewTest {
 protected:
  Recall() {
    items.addCount(2);
    view = new Watched<ZQVSenderView>(&isGone, items.list(), true, false, 4294967295u, "Minji", 1,
                                      nullptr);
    app_control_h request = nullptr;
    app_control_create(&request);
    view->setLaunchRequest(request);
    app_control_destroy(request);
    push(view);
    log.clear();
  }
  void tapRecall() { ZQVSenderView::_recallBtnCb(view, nullptr, nullptr); }
  void tapReshare() { ZQVSenderView::_reshareBtnCb(view, nullptr, nullptr); }
  /// Taps Recall and OK, and waits until only the progress popup is left.
  void recall() {
    tapRecall();
    ASSERT_TRUE(waitForPopup());
    click(popupButton(2));
    ASSERT_TRUE(waitUntil([] { return popup() && !popupButton(1); }));
  }
  void answer(int error) {
    ASSERT_FALSE(phone.recalls.empty());
    phone.recalls.back().callback(error, phone.recalls.back().userData);
  }

  Watched<ZQVSenderView>* view = nullptr;
  bool isGone = false;
};

TEST_F(Recall, LeadsToTheAuthenticationPageWithoutAnAccount) {
  phone.imsi = nullptr;
  tapRecall();
  EXPECT_THAT(log.errors(), ElementsAre("Ovu NOK!"));
  EXPECT_EQ(log.functionOf("Ovu NOK!"), "_checkZelqoStatus");
  ASSERT_EQ(phone.forwards.size(), 1u);
  EXPECT_THAT(phone.forwards[0].server, ElementsAre("keld"));
  EXPECT_EQ(popup(), nullptr);
  EXPECT_THAT(phone.usage, IsEmpty());
}

TEST_F(Recall, LeadsToTheSettingsPageWhenSharingIsOff) {
  phone.serviceStatus = "off";
  tapRecall();
  EXPECT_THAT(log.errors(), ElementsAre("ZQ NOK!"));
  EXPECT_EQ(log.functionOf("ZQ NOK!"), "_checkZelqoStatus");
  ASSERT_EQ(phone.forwards.size(), 1u);
  EXPECT_EQ(phone.forwards[0].operation, "http://tizen.org/appcontrol/operation/setting");
  EXPECT_EQ(popup(), nullptr);
}

TEST_F(Recall, LeadsToTheSettingsPageWhenTheServiceStatusFails) {
  phone.accountErrors.status = -5;
  tapRecall();
  EXPECT_THAT(log.errors(), ElementsAre("ovu_get_service_status failed [-5]",
                                        "share_check_ovu_service_status failed!", "ZQ NOK!"));
  ASSERT_EQ(phone.forwards.size(), 1u);
  EXPECT_EQ(phone.forwards[0].operation, "http://tizen.org/appcontrol/operation/setting");
}

TEST_F(Recall, GoesOnAfterAnEarlierPassWhenTheAccountCannotBeAsked) {
  tapReshare();
  phone.accountErrors.open = -5;
  tapRecall();
  EXPECT_TRUE(waitForPopup());
  EXPECT_THAT(phone.forwards, IsEmpty());
}

TEST_F(Recall, AsksBeforeItRecalls) {
  tapRecall();
  ASSERT_TRUE(waitForPopup());
  EXPECT_EQ(textOf(popup(), "title,text"), zqvText("IDS_RSH_BUTTON_RECALL_ABB"));
  EXPECT_EQ(textOf(popup()),
            zqvText("IDS_RSH_POP_THE_RECIPIENT_WILL_NO_LONGER_BE_ABLE_TO_DOWNLOAD_THE_FILES"));
  EXPECT_EQ(textOf(popupButton(1)), zqvText("IDS_RSH_BUTTON_CANCEL_ABB2"));
  EXPECT_EQ(textOf(popupButton(2)), zqvText("IDS_RSH_BUTTON_OK"));
  EXPECT_THAT(phone.usageOf("ZQ57"), ElementsAre("(none)"));
  EXPECT_THAT(phone.recalls, IsEmpty());
}

TEST_F(Recall, SendsNothingOnCancel) {
  const History history;
  tapRecall();
  ASSERT_TRUE(waitForPopup());
  click(popupButton(1));
  EXPECT_TRUE(waitForNoPopup());
  EXPECT_THAT(phone.recalls, IsEmpty());
  EXPECT_EQ(phone.exits, 0);
  EXPECT_THAT(history.heard, IsEmpty());
}

TEST_F(Recall, AsksTheServiceAndShowsProgressOnOk) {
  recall();
  ASSERT_EQ(phone.recalls.size(), 1u);
  EXPECT_EQ(phone.recalls[0].requestId, 4294967295u);
  Evas_Object* layout = elm_object_content_get(popup());
  EXPECT_EQ(textOf(layout, "elm.text"), zqvText("IDS_RSH_POP_RECALLING_FILES_ING"));
  EXPECT_NE(elm_object_part_content_get(layout, "processing"), nullptr);
  EXPECT_DOUBLE_EQ(elm_popup_timeout_get(popup()), 60.0);
  EXPECT_THAT(log.errors(), IsEmpty());
}

TEST_F(Recall, KeepsTheProgressWhenTheServiceRefuses) {
  phone.recallError = -111;
  recall();
  EXPECT_THAT(log.errors(), Contains("zelqo_recall_upload error!"));
  EXPECT_NE(popup(), nullptr);
}

TEST_F(Recall, KeepsTheProgressWhenTheAnswerIsAFailure) {
  const History history;
  recall();
  answer(-101);
  EXPECT_THAT(log.errors(), Contains("Error happened(error_code = -101)"));
  EXPECT_NE(popup(), nullptr);
  EXPECT_EQ(phone.exits, 0);
  EXPECT_THAT(history.heard, IsEmpty());
}

TEST_F(Recall, TellsTheHistoryOnceAndEnds) {
  History history;
  recall();
  answer(0);
  EXPECT_EQ(phone.exits, 1);
  answer(0);
  EXPECT_EQ(phone.exits, 1) << "answered twice";
  EXPECT_EQ(log.count("user_data is NULL"), 1);
  history.settle();
  EXPECT_THAT(history.heard, ElementsAre("recall ('default',)"));
}

TEST_F(Recall, MaySucceedAfterAFailedAnswer) {
  recall();
  answer(-101);
  answer(0);
  EXPECT_EQ(phone.exits, 1);
}

TEST_F(Recall, HearsNoAnswerAfterThePageIsGone) {
  recall();
  const RecallRequest request = phone.recalls[0];
  naviframe.destroyAllViewControllers();
  ASSERT_TRUE(isGone);
  EXPECT_TRUE(waitForNoPopup()) << "the progress goes with the page";
  log.clear();
  request.callback(0, request.userData);
  EXPECT_EQ(phone.exits, 0);
  EXPECT_THAT(log.errors(), ElementsAre("user_data is NULL"));
}

TEST_F(Recall, LogsAnAnswerWithoutItsPage) {
  ZQVSenderView::_recallUploadCb(0, nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("user_data is NULL"));
  EXPECT_EQ(phone.exits, 0);
}

TEST_F(Recall, SaysThatItFailedWhenTimeIsUp) {
  recall();
  evas_object_smart_callback_call(popup(), "timeout", nullptr);
  EXPECT_TRUE(waitForNoPopup());
  EXPECT_THAT(phone.statusMessages,
              ElementsAre(zqvText("IDS_RSH_TPOP_COULDNT_RECALL_FILE_TRY_AGAIN")));
  EXPECT_THAT(log.traces(), Contains("Protect In EVAS_CALLBACK_DEL!!"));
  EXPECT_FALSE(isGone);
  view->update(kLanguageChanged);
}

TEST_F(Recall, CanBeTriedAgainAfterTheTimeIsUp) {
  recall();
  evas_object_smart_callback_call(popup(), "timeout", nullptr);
  ASSERT_TRUE(waitForNoPopup());
  recall();
  EXPECT_EQ(phone.recalls.size(), 2u);
  answer(0);
  EXPECT_EQ(phone.exits, 1);
}

TEST_F(Recall, SetsTheProgressTextAgainWhenTheLanguageChanges) {
  recall();
  Evas_Object* layout = elm_object_content_get(popup());
  elm_object_part_text_set(layout, "elm.text", "old");
  view->update(kLanguageChanged);
  EXPECT_EQ(textOf(layout, "elm.text"), zqvText("IDS_RSH_POP_RECALLING_FILES_ING"));
}

TEST_F(Recall, SignalReachesTheBusEvenWhenTheProcessEndsAtOnce) {
  constexpr int kTimes = 50;
  History history;
  for (int i = 0; i < kTimes; ++i) {
    const char* command[] = {"/proc/self/exe", kSendAndEnd, nullptr};
    int status = -1;
    ASSERT_TRUE(g_spawn_sync(nullptr, const_cast<char**>(command), nullptr, G_SPAWN_DEFAULT,
                             nullptr, nullptr, nullptr, nullptr, &status, nullptr));
    ASSERT_EQ(status, 0);
  }
  EXPECT_TRUE(waitUntil([&] {
    history.settle();
    return history.heard.size() >= kTimes;
  }));
  EXPECT_EQ(history.heard.size(), static_cast<size_t>(kTimes));
}

TEST_F(Recall, ReshareHandsTheShareToTheContactsPicker) {
  tapReshare();
  EXPECT_THAT(phone.usageOf("ZQ58"), ElementsAre("(none)"));
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_EQ(phone.launches[0].appId, "contacts-tabui-efl");
  EXPECT_THAT(phone.launches[0].extra("zq_reshare"), ElementsAre("4294967295"));
  EXPECT_THAT(phone.launches[0].extra("ct_operation"), ElementsAre(APP_CONTROL_OPERATION_SHARE))
      << "the page's first flag is handed on as it is";
}

TEST_F(Recall, ReshareNeedsTheAccountToo) {
  phone.imsi = nullptr;
  tapReshare();
  EXPECT_THAT(log.errors(), ElementsAre("Ovu NOK!"));
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.usage, IsEmpty());
}

TEST_F(Recall, ReshareOfSeveralFilesIsAMultiShare) {
  auto* several = new ZQVSenderView(items.list(), false, false, 7, "Minji", 1, nullptr);
  push(several);
  ZQVSenderView::_reshareBtnCb(several, nullptr, nullptr);
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].extra("zq_reshare"), ElementsAre("7"));
  EXPECT_THAT(phone.launches[0].extra("ct_operation"),
              ElementsAre(APP_CONTROL_OPERATION_MULTI_SHARE));
}
