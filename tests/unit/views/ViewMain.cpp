#include <gio/gio.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <string>

#include "HistorySignal.h"
#include "ViewTest.h"

int main(int argc, char** argv) {
  // What the child of the history test does: it needs the bus of its parent and nothing else.
  if (argc == 2 && strcmp(argv[1], kSendAndEnd) == 0) sendHistorySignalAndEnd();

  // Buses of its own, whatever runs around.
  const char* screen = getenv("DISPLAY");
  const std::string display = screen ? screen : "";
  GTestDBus* bus = g_test_dbus_new(G_TEST_DBUS_NONE);
  g_test_dbus_up(bus);
  // The test bus forgets the screen, too.
  setenv("DISPLAY", display.c_str(), 1);
  setenv("DBUS_SYSTEM_BUS_ADDRESS", g_test_dbus_get_bus_address(bus), 1);
  setenv("ELM_PROFILE", "mobile", 1);
  setenv("APP_ASSIST_THEME", TEST_THEME, 1);
  setenv("EINA_LOG_BACKTRACE", "-1", 0);
  setenv("EINA_LOG_LEVELS", "eldbus:0,ecore_con:0,eina_safety:0", 0);

  testing::InitGoogleMock(&argc, argv);
  TestApp app(argc, argv);
  app.start(argc, argv);
  // Without the clean-up of GIO: it would wait for connections that live as long as the process.
  fflush(stdout);
  g_test_dbus_stop(bus);
  _exit(app.result());
}
