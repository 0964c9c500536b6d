#include "ZQVApp.h"

int main(int argc, char** argv) {
  ZQVApp app(argc, argv);
  return app.start(argc, argv);
}
