#include <Elementary.h>
#include <gtest/gtest.h>

#include <cstdlib>

/// No screen is needed: the pages are drawn into memory.
int main(int argc, char** argv) {
  setenv("ELM_ENGINE", "buffer", 1);
  setenv("ELM_PROFILE", "mobile", 1);
  setenv("EINA_LOG_BACKTRACE", "-1", 0);
  setenv("LC_ALL", "C.UTF-8", 1);
  unsetenv("LANGUAGE");
  setenv("TZ", "UTC", 1);
  testing::InitGoogleTest(&argc, argv);
  elm_init(argc, argv);
  const int result = RUN_ALL_TESTS();
  elm_shutdown();
  return result;
}
