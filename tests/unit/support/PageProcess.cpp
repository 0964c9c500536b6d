#include "PageProcess.h"

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <string>

PageProcess::PageProcess(const char* theme) : _bus(g_test_dbus_new(G_TEST_DBUS_NONE)) {
  const char* screen = getenv("DISPLAY");
  const std::string display = screen ? screen : "";
  g_test_dbus_up(_bus);
  // The test bus forgets the screen, too.
  setenv("DISPLAY", display.c_str(), 1);
  setenv("DBUS_SYSTEM_BUS_ADDRESS", g_test_dbus_get_bus_address(_bus), 1);
  setenv("ELM_PROFILE", "mobile", 1);
  setenv("APP_ASSIST_THEME", theme, 1);
  setenv("EINA_LOG_BACKTRACE", "-1", 0);
  setenv("EINA_LOG_LEVELS", "eldbus:0,ecore_con:0,eina_safety:0", 0);
}

void PageProcess::end(int result) {
  fflush(stdout);
  g_test_dbus_stop(_bus);
  _exit(result);
}
