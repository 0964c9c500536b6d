#include <cstring>

#include "HistorySignal.h"
#include "ViewTest.h"

int main(int argc, char** argv) {
  // What the child of the history test does: it needs the bus of its parent and nothing else.
  if (argc == 2 && strcmp(argv[1], kSendAndEnd) == 0) sendHistorySignalAndEnd();
  runViewTests(argc, argv);
}
