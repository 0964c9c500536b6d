#include <Eina.h>
#include <gmock/gmock.h>

int main(int argc, char** argv) {
  eina_init();
  testing::InitGoogleMock(&argc, argv);
  const int result = RUN_ALL_TESTS();
  eina_shutdown();
  return result;
}
