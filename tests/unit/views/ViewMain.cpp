#include <gio/gio.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>

#include "HistorySignal.h"
#include "ViewTest.h"

int main(int argc, char** argv) {
  // What the child of the history test does: it needs the bus of its parent and nothing else.
  if (argc == 2 && strcmp(argv[1], kSendAndEnd) == 0) sendHistorySignalAndEnd();

  // Buses of its own, whatever runs around.
  GTestDBus* bus = g_test_dbus_new(G_TEST_DBUS_NONE);
  g_test_dbus_up(bus);
  setenv("DBUS_SYSTEM_BUS_ADDRESS", g_test_dbus_get_bus_address(bus), 1);
  setenv("APPFW_APP_ID", "com.orlant.zelqo", 1);
  setenv("ELM_PROFILE", "mobile", 1);
  if (!getenv("DISPLAY")) setenv("ELM_ENGINE", "buffer", 1);

  testing::InitGoogleMock(&argc, argv);
  TestApp app(argc, argv);
  app.start(argc, argv);
  // Without the clean-up of GIO: it would wait for connections that live as long as the process.
  fflush(stdout);
  g_test_dbus_stop(bus);
  _exit(app.result());
}
