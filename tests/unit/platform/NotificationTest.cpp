#include "TestPhone.h"

#include <notification.h>
#include <notification/post.h>
#include <notification/status.h>

#include <vector>

namespace {

/// The notification daemon: keeps what it is told to show.
class FakeDaemon {
 public:
  struct Shown {
    unsigned replaces;
    std::string summary, body;
    std::vector<std::string> actions;
    int timeoutMs;
  };

  FakeDaemon() {
    static const GDBusInterfaceVTable calls = {notifyCb, nullptr, nullptr, {}};
    common::Owned<GDBusNodeInfo, g_dbus_node_info_unref> node(g_dbus_node_info_new_for_xml(
        "<node><interface name='org.freedesktop.Notifications'><method name='Notify'>"
        "<arg type='s' direction='in'/><arg type='u' direction='in'/>"
        "<arg type='s' direction='in'/><arg type='s' direction='in'/>"
        "<arg type='s' direction='in'/><arg type='as' direction='in'/>"
        "<arg type='a{sv}' direction='in'/><arg type='i' direction='in'/>"
        "<arg type='u' direction='out'/></method></interface></node>",
        nullptr));
    g_dbus_connection_register_object(_bus.get(), "/org/freedesktop/Notifications",
                                      node->interfaces[0], &calls, this, nullptr, nullptr);
    common::OwnedVariant answer(g_dbus_connection_call_sync(
        _bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
        "RequestName", g_variant_new("(su)", "org.freedesktop.Notifications", 0u), nullptr,
        G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
  }

  ~FakeDaemon() { g_dbus_connection_close_sync(_bus.get(), nullptr, nullptr); }

  /// Waits for so many messages, and until the answers to them are on their way.
  bool waitFor(size_t count) {
    const bool there = waitUntil([&] { return shown.size() >= count; });
    g_dbus_connection_flush_sync(_bus.get(), nullptr, nullptr);
    return there;
  }

  void emit(const char* signal, GVariant* arguments) {
    g_dbus_connection_emit_signal(_bus.get(), nullptr, "/org/freedesktop/Notifications",
                                  "org.freedesktop.Notifications", signal, arguments, nullptr);
    g_dbus_connection_flush_sync(_bus.get(), nullptr, nullptr);
  }

  std::vector<Shown> shown;

 private:
  static void notifyCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                       GVariant* arguments, GDBusMethodInvocation* invocation, void* data) {
    auto* self = static_cast<FakeDaemon*>(data);
    Shown shown{};
    const char *summary = nullptr, *body = nullptr;
    common::Owned<const char*, g_free> actions;
    const char** names = nullptr;
    g_variant_get(arguments, "(&su&s&s&s^a&s@a{sv}i)", nullptr, &shown.replaces, nullptr, &summary,
                  &body, &names, nullptr, &shown.timeoutMs);
    actions.reset(names);
    shown.summary = summary;
    shown.body = body;
    for (const char** name = names; *name; name++) shown.actions.push_back(*name);
    self->shown.push_back(shown);
    const unsigned number = shown.replaces ? shown.replaces : ++self->_count;
    g_dbus_method_invocation_return_value(invocation, g_variant_new("(u)", number));
  }

  common::OwnedBus _bus = otherConnection();
  unsigned _count = 100;
};

}  // namespace

TEST(StatusMessage, IsShownAsItStands) {
  FakeDaemon daemon;
  EXPECT_EQ(notification_status_message_post("50 % of <b>\"a\" & b</b>"), NOTIFICATION_ERROR_NONE);
  ASSERT_TRUE(daemon.waitFor(1));
  EXPECT_EQ(daemon.shown[0].body, "50 % of &lt;b&gt;&quot;a&quot; &amp; b&lt;/b&gt;");
  EXPECT_EQ(daemon.shown[0].timeoutMs, 3000);
  EXPECT_TRUE(daemon.shown[0].actions.empty());
}

TEST(StatusMessage, TakesThePlaceOfTheOneBefore) {
  FakeDaemon daemon;
  notification_status_message_post("first");
  ASSERT_TRUE(daemon.waitFor(1));
  settle();
  notification_status_message_post("second");
  ASSERT_TRUE(daemon.waitFor(2));
  EXPECT_GT(daemon.shown[1].replaces, 0u);
}

TEST(StatusMessage, ReachesEveryStatusBar) {
  std::vector<std::string> heard;
  const notification::StatusMessages one([&](const std::string& text) { heard.push_back(text); });
  const notification::StatusMessages other([&](const std::string& text) { heard.push_back(text); });
  notification_status_message_post("caf\xe9 & <b>");
  EXPECT_TRUE(waitUntil([&] { return heard.size() == 2; }));
  EXPECT_EQ(heard, std::vector<std::string>(2, "caf\xef\xbf\xbd & <b>"));
}

TEST(StatusMessage, NeedsAText) {
  EXPECT_EQ(notification_status_message_post(nullptr), NOTIFICATION_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(notification_status_message_post(""), NOTIFICATION_ERROR_INVALID_PARAMETER);
}

TEST(StatusMessage, MayHoldWhatIsNotUtf8) {
  FakeDaemon daemon;
  EXPECT_EQ(notification_status_message_post("caf\xe9"), NOTIFICATION_ERROR_NONE);
  ASSERT_TRUE(daemon.waitFor(1));
  EXPECT_EQ(daemon.shown[0].body, "caf\xef\xbf\xbd");
}

TEST(StatusMessage, IsNoFailureWithoutADaemon) {
  EXPECT_EQ(notification_status_message_post("nobody shows this"), NOTIFICATION_ERROR_NONE);
  settle();
}

TEST(Notification, RunsItsActionOnceWhenOpened) {
  FakeDaemon daemon;
  int opened = 0;
  ASSERT_TRUE(notification::post("done", [&] { opened++; }));
  ASSERT_TRUE(daemon.waitFor(1));
  EXPECT_EQ(daemon.shown[0].actions, (std::vector<std::string>{"default", ""}));
  settle();
  daemon.emit("ActionInvoked", g_variant_new("(us)", 999u, "default"));
  daemon.emit("ActionInvoked", g_variant_new("(us)", 101u, "default"));
  daemon.emit("ActionInvoked", g_variant_new("(us)", 101u, "default"));
  settle();
  EXPECT_EQ(opened, 1);
}

TEST(Notification, DoesNothingAfterItWasClosed) {
  FakeDaemon daemon;
  int opened = 0;
  notification::post("done", [&] { opened++; });
  ASSERT_TRUE(daemon.waitFor(1));
  settle();
  daemon.emit("NotificationClosed", g_variant_new("(uu)", 101u, 2u));
  daemon.emit("ActionInvoked", g_variant_new("(us)", 101u, "default"));
  daemon.emit("ActionInvoked", g_variant_new("(i)", 101));
  settle();
  EXPECT_EQ(opened, 0);
}

TEST(Notification, NeedsAText) {
  EXPECT_FALSE(notification::post("", nullptr));
}
