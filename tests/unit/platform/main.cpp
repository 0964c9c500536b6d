#include "TestPhone.h"

int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  testing::AddGlobalTestEnvironment(new TestPhone);
  return RUN_ALL_TESTS();
}
