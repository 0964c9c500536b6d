// What arrives at an application, sent by hand as a stranger would.
#include "ReceivedRequests.h"

#include <app_control_internal.h>
#include <appfw/BusNames.h>
#include <appfw/CallerName.h>
#include <aul.h>

namespace {

/// Another process that calls Launch with whatever it likes.
class Stranger {
 public:
  GDBusConnection* bus() { return _bus.get(); }
  bool claims(const char* appId) {
    return appfw::requestName(_bus.get(), appfw::busName(appId), 1);
  }
  /// The answer is awaited; false when the call was refused.
  bool launch(GVariant* bundle, const char* replyPath = "/") {
    struct Answer {
      bool done = false, accepted = false;
    } answer;
    g_dbus_connection_call(
        _bus.get(), appfw::busName(TestPhone::kAppId).c_str(), appfw::kAppPath,
        appfw::kAppInterface, "Launch", g_variant_new("(@a{sv}o)", bundle, replyPath), nullptr,
        G_DBUS_CALL_FLAGS_NONE, -1, nullptr,
        [](GObject* bus, GAsyncResult* result, void* data) {
          common::OwnedVariant value(
              g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, nullptr));
          *static_cast<Answer*>(data) = {true, value != nullptr};
        },
        &answer);
    waitUntil([&] { return answer.done; });
    return answer.accepted;
  }

 private:
  common::OwnedBus _bus = otherConnection();
};

GVariant* parse(const char* text) {
  return g_variant_parse(G_VARIANT_TYPE_VARDICT, text, nullptr, nullptr, nullptr);
}

class AnAppService : public testing::Test {
 protected:
  ReceivedRequests _received;
  Stranger _stranger;
};

}  // namespace

TEST_F(AnAppService, DeliversEarlyRequestsInOrderOnceItIsReady) {
  for (const char* text : {"{'n': <'1'>}", "{'n': <'2'>}", "{'n': <'3'>}"}) {
    EXPECT_TRUE(_stranger.launch(parse(text)));
  }
  EXPECT_EQ(_received.count(), 0u);
  _received.start();
  ASSERT_TRUE(_received.waitFor(3));
  EXPECT_EQ(_received.extra(_received[0], "n"), "1");
  EXPECT_EQ(_received.extra(_received[1], "n"), "2");
  EXPECT_EQ(_received.extra(_received[2], "n"), "3");
}

TEST_F(AnAppService, AcknowledgesBeforeItHandlesTheRequest) {
  EXPECT_TRUE(_stranger.launch(parse("{'n': <'1'>}")));
  EXPECT_EQ(_received.count(), 0u);
}

TEST_F(AnAppService, HasTheCallerFromTheBus) {
  ASSERT_TRUE(_stranger.claims("test.other"));
  _received.start();
  _stranger.launch(parse("{}"));
  ASSERT_TRUE(_received.waitFor(1));
  EXPECT_EQ(_received.caller(_received[0]), "test.other");
}

TEST_F(AnAppService, IgnoresWhoTheCallerClaimsToBe) {
  _received.start();
  _stranger.launch(
      parse("{'__AUL_CALLER_APPID__': <'com.orlant.zelqo'>,"
            "'__AUL_CALLER_PID__': <'1'>, '__AUL_WAIT_RESULT__': <'1'>}"));
  ASSERT_TRUE(_received.waitFor(1));
  EXPECT_EQ(_received.caller(_received[0]), "error -126");
  bool requested = true;
  EXPECT_EQ(app_control_is_reply_requested(_received[0], &requested), APP_CONTROL_ERROR_NONE);
  EXPECT_FALSE(requested);
  bundle* exported = nullptr;
  app_control_export_as_bundle(_received[0], &exported);
  EXPECT_EQ(std::string(bundle_get_val(exported, AUL_K_CALLER_PID)), std::to_string(getpid()));
  bundle_free(exported);
}

TEST_F(AnAppService, KnowsACallerThatOnlyWaitsForItsName) {
  Stranger owner;
  ASSERT_TRUE(owner.claims("test.other"));
  ASSERT_TRUE(_stranger.claims("test.other"));
  _received.start();
  _stranger.launch(parse("{}"));
  ASSERT_TRUE(_received.waitFor(1));
  EXPECT_EQ(_received.caller(_received[0]), "test.other");
}

TEST_F(AnAppService, LeavesOutWhatABundleCannotHold) {
  _received.start();
  EXPECT_TRUE(
      _stranger.launch(parse("{'number': <7>, '': <'no key'>, 'deep': <<<'x'>>>,"
                             "'bytes': <b'abc'>, 'text': <'kept'>, 'list': <['a', 'b']>,"
                             "'empty': <@as []>}")));
  ASSERT_TRUE(_received.waitFor(1));
  EXPECT_EQ(_received.extraKeys(_received[0]), (std::vector<std::string>{"text", "list", "empty"}));
}

TEST_F(AnAppService, TakesTheFirstOfTwoValuesOfAKey) {
  GVariantBuilder entries;
  g_variant_builder_init(&entries, G_VARIANT_TYPE_VARDICT);
  g_variant_builder_add(&entries, "{sv}", "k", g_variant_new_string("first"));
  g_variant_builder_add(&entries, "{sv}", "k", g_variant_new_string("second"));
  _received.start();
  _stranger.launch(g_variant_builder_end(&entries));
  ASSERT_TRUE(_received.waitFor(1));
  EXPECT_EQ(_received.extra(_received[0], "k"), "first");
}

TEST_F(AnAppService, RefusesWhatIsTooLargeAndGoesOn) {
  GVariantBuilder entries;
  g_variant_builder_init(&entries, G_VARIANT_TYPE_VARDICT);
  g_variant_builder_add(&entries, "{sv}", "k",
                        g_variant_new_string(std::string(1100000, 'x').c_str()));
  _received.start();
  EXPECT_FALSE(_stranger.launch(g_variant_builder_end(&entries)));
  EXPECT_TRUE(_stranger.launch(parse("{'n': <'next'>}")));
  ASSERT_TRUE(_received.waitFor(1));
  EXPECT_EQ(_received.extra(_received[0], "n"), "next");
}

TEST_F(AnAppService, TakesExtrasOf64KiB) {
  GVariantBuilder entries;
  g_variant_builder_init(&entries, G_VARIANT_TYPE_VARDICT);
  g_variant_builder_add(&entries, "{sv}", "k",
                        g_variant_new_string(std::string(65536, 'x').c_str()));
  _received.start();
  EXPECT_TRUE(_stranger.launch(g_variant_builder_end(&entries)));
  ASSERT_TRUE(_received.waitFor(1));
  EXPECT_EQ(_received.extra(_received[0], "k").size(), 65536u);
}

TEST_F(AnAppService, RefusesAFloodBeforeItIsReady) {
  bool accepted = true;
  int count = 0;
  while (accepted && count < 1000) {
    accepted = _stranger.launch(parse("{}"));
    count += accepted;
  }
  EXPECT_EQ(count, 64);
}

TEST_F(AnAppService, SaysWhenTheNameIsLost) {
  common::OwnedBus bus = base::sessionBus();
  common::OwnedVariant answer(g_dbus_connection_call_sync(
      bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "ReleaseName", g_variant_new("(s)", appfw::busName(TestPhone::kAppId).c_str()), nullptr,
      G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
  EXPECT_TRUE(waitUntil([&] { return _received.nameLost(); }));
}

TEST(AnAppServiceThatIsNotAlone, DoesNotStart) {
  common::OwnedBus other = otherConnection();
  ASSERT_TRUE(appfw::requestName(other.get(), appfw::busName("test.taken"), 4));
  appfw::AppService service("test.taken");
  EXPECT_FALSE(service.start([] {}));
}

TEST(AnAppServiceWhoseNameAToolUses, TakesItOver) {
  common::OwnedBus other = otherConnection();
  constexpr unsigned allowReplacement = 1;
  ASSERT_TRUE(appfw::requestName(other.get(), appfw::busName("test.borrowed"), allowReplacement));
  appfw::AppService service("test.borrowed");
  EXPECT_TRUE(service.start([] {}));
  const std::string tool = g_dbus_connection_get_unique_name(other.get());
  common::OwnedBus bus = base::sessionBus();
  EXPECT_EQ(appfw::findCaller(bus.get(), tool.c_str()).appId, "test.borrowed");
}
