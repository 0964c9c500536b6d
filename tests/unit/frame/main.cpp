#include <Ecore_X.h>
#include <Elementary.h>
#include <gtest/gtest.h>

#include "DeviceTheme.h"
#include "GlibBridge.h"

int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  if (!elm_init(argc, argv) || !ecore_x_init(nullptr)) return 1;
  app_assist::installGlibBridge();
  app_assist::DeviceTheme::install();
  const int result = RUN_ALL_TESTS();
  ecore_x_shutdown();
  elm_shutdown();
  return result;
}
