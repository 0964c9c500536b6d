#include <gtest/gtest.h>

#include <cstdlib>

#include "TempFolder.h"

// The library's own store lies in a phone of the test's own.
int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  const TempFolder phone;
  setenv("APPFW_ROOT", phone.path().c_str(), 1);
  return RUN_ALL_TESTS();
}
