#include <csignal>

#include "DownloadApp.h"

int main(int argc, char** argv) {
  // A file that may not grow is a full disk to the user, not the end of the application.
  std::signal(SIGXFSZ, SIG_IGN);
  return downloads::DownloadApp(argc, argv).start(argc, argv);
}
