#include <Ecore_X.h>
#include <Elementary.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

#include "DeviceTheme.h"
#include "GlibBridge.h"

int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  // The theme of this build and settings of its own, whatever phone this runs in.
  char root[] = "/tmp/frame-test-XXXXXX";
  if (!mkdtemp(root)) return 1;
  setenv("APPFW_ROOT", root, 1);
  setenv("APPFW_APP_ID", "test.frame", 1);
  setenv("APP_ASSIST_THEME", EDJE_DIR "/device.edj", 1);
  if (!elm_init(argc, argv) || !ecore_x_init(nullptr)) return 1;
  app_assist::installGlibBridge();
  app_assist::DeviceTheme::install();
  const int result = RUN_ALL_TESTS();
  ecore_x_shutdown();
  elm_shutdown();
  std::filesystem::remove_all(root);
  return result;
}
