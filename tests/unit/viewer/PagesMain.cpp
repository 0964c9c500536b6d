#include <cstdlib>

#include "PageProcess.h"
#include "PageTest.h"

int main(int argc, char** argv) {
  setenv("LC_ALL", "C.UTF-8", 1);
  setenv("TZ", "UTC", 1);
  PageProcess process(TEST_THEME);
  testing::InitGoogleTest(&argc, argv);
  TestViewer viewer(argc, argv);
  viewer.start(argc, argv);
  process.end(viewer.result());
}
