#include "Owned.h"

#include <unistd.h>

namespace service {

Fd::~Fd() {
  close();
}

void Fd::close() {
  if (_fd >= 0) ::close(_fd);
  _fd = -1;
}

}  // namespace service
