#include <Elementary.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  // Windows nobody sees, and settings of its own, whatever phone this runs in.
  char root[] = "/tmp/theme-test-XXXXXX";
  if (!mkdtemp(root)) return 1;
  setenv("APPFW_ROOT", root, 1);
  setenv("APPFW_APP_ID", "test.theme", 1);
  setenv("APP_ASSIST_THEME", DEVICE_THEME, 1);
  setenv("ELM_ENGINE", "buffer", 1);
  if (!elm_init(argc, argv)) return 1;
  elm_config_scale_set(2.6);
  elm_theme_overlay_add(nullptr, DEVICE_THEME);
  const int result = RUN_ALL_TESTS();
  elm_shutdown();
  std::filesystem::remove_all(root);
  return result;
}
