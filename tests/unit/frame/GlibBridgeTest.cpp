#include <Ecore.h>
#include <gio/gio.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include "Loop.h"

namespace {

gboolean count(gpointer data) {
  ++*static_cast<int*>(data);
  return G_SOURCE_REMOVE;
}

/// Two users of the phone's session bus that share nothing with the rest of this process.
class Strangers {
 public:
  ~Strangers() {
    for (GDBusConnection* connection : {sender, receiver}) {
      g_dbus_connection_close_sync(connection, nullptr, nullptr);
      g_object_unref(connection);
    }
  }

  GDBusConnection* const sender = connect();
  GDBusConnection* const receiver = connect();

 private:
  static GDBusConnection* connect() {
    char* address = g_dbus_address_get_for_bus_sync(G_BUS_TYPE_SESSION, nullptr, nullptr);
    GDBusConnection* connection = g_dbus_connection_new_for_address_sync(
        address,
        static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                          G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION),
        nullptr, nullptr, nullptr);
    g_free(address);
    return connection;
  }
};

}  // namespace

TEST(GlibBridge, RunsIdlesAndTimeoutsUnderTheToolkitsLoop) {
  int idles = 0, timeouts = 0;
  g_idle_add(count, &idles);
  g_timeout_add(1, count, &timeouts);
  EXPECT_TRUE(waitUntil([&] { return idles == 1 && timeouts == 1; }));
}

TEST(GlibBridge, WakesForATimeoutWhenTheToolkitHasNothingToDo) {
  g_timeout_add(
      20,
      [](gpointer) -> gboolean {
        ecore_main_loop_quit();
        return G_SOURCE_REMOVE;
      },
      nullptr);
  ecore_main_loop_begin();  // comes back only when the timeout runs
}

TEST(GlibBridge, DeliversSignalsOfABus) {
  const Strangers bus;
  int signals = 0;
  g_dbus_connection_signal_subscribe(
      bus.receiver, nullptr, "test.Bridge", "Ping", "/bridge", nullptr, G_DBUS_SIGNAL_FLAGS_NONE,
      [](GDBusConnection*, const char*, const char*, const char*, const char*, GVariant*,
         gpointer data) { ++*static_cast<int*>(data); },
      &signals, nullptr);
  // The answer to this call tells that the bus knows of the subscription.
  g_variant_unref(g_dbus_connection_call_sync(
      bus.receiver, "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "GetId", nullptr, nullptr, G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
  for (int i = 0; i < 50; i++) {
    g_dbus_connection_emit_signal(bus.sender, nullptr, "/bridge", "test.Bridge", "Ping", nullptr,
                                  nullptr);
  }
  EXPECT_TRUE(waitUntil([&] { return signals == 50; }));
}

TEST(GlibBridge, LeavesTheToolkitsTimersRunningBesideABusySource) {
  int idles = 0, ticks = 0;
  const guint busy = g_idle_add(
      [](gpointer data) -> gboolean {
        ++*static_cast<int*>(data);
        return G_SOURCE_CONTINUE;
      },
      &idles);
  Ecore_Timer* timer = ecore_timer_add(
      0.001,
      [](void* data) -> Eina_Bool {
        ++*static_cast<int*>(data);
        return ECORE_CALLBACK_RENEW;
      },
      &ticks);
  EXPECT_TRUE(waitUntil([&] { return idles > 20 && ticks > 20; }));
  ecore_timer_del(timer);
  g_source_remove(busy);
}

TEST(GlibBridge, ReportsFilesToTheToolkit) {
  int ends[2];
  ASSERT_EQ(pipe(ends), 0);
  char received = 0;
  Ecore_Fd_Handler* handler = ecore_main_fd_handler_add(
      ends[0], ECORE_FD_READ,
      [](void* data, Ecore_Fd_Handler* self) -> Eina_Bool {
        if (read(ecore_main_fd_handler_fd_get(self), data, 1) != 1) *static_cast<char*>(data) = '!';
        return ECORE_CALLBACK_RENEW;
      },
      &received, nullptr, nullptr);
  ASSERT_EQ(write(ends[1], "x", 1), 1);
  EXPECT_TRUE(waitUntil([&] { return received == 'x'; }));
  ecore_main_fd_handler_del(handler);
  close(ends[0]);
  close(ends[1]);
}

TEST(GlibBridge, AllowsANestedLoopInACallback) {
  int nested = 0;
  g_idle_add(
      [](gpointer data) -> gboolean {
        GMainLoop* loop = g_main_loop_new(nullptr, FALSE);
        g_timeout_add(
            5,
            [](gpointer inner) -> gboolean {
              g_main_loop_quit(static_cast<GMainLoop*>(inner));
              return G_SOURCE_REMOVE;
            },
            loop);
        g_main_loop_run(loop);
        g_main_loop_unref(loop);
        ++*static_cast<int*>(data);
        return G_SOURCE_REMOVE;
      },
      &nested);
  EXPECT_TRUE(waitUntil([&] { return nested == 1; }));
}
