#include <cstdlib>

#include "../views/ViewTest.h"

int main(int argc, char** argv) {
  // The same inputs every time, so that a failure comes again. RC_PARAMS="max_success=10000" looks
  // further.
  setenv("RC_PARAMS", "seed=1", 0);
  runViewTests(argc, argv);
}
