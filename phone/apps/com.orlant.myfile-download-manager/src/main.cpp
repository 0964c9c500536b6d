#include "DownloadApp.h"

int main(int argc, char** argv) {
  return downloads::DownloadApp(argc, argv).start(argc, argv);
}
