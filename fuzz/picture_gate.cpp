// A picture's header, read by hand before the toolkit's loaders see the file.

#include "ZQVPictureGate.h"

#include "TemporaryFile.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static TemporaryFile file;
  file.write(data, size);
  ZQVPictureGate::passes(file.path(), ZQVPictureGate::Thumbnail);
  ZQVPictureGate::passes(file.path(), ZQVPictureGate::FullView);
  return 0;
}
