// The file manager's list of downloaded files: any bytes may stand in it.

#include "ZQVSharedFiles.h"

#include "TemporaryFile.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static TemporaryFile file;
  file.write(data, size);
  ZQVSharedFiles files(file.path());
  files.pathOf("http://127.0.0.1/share/T/file/0");
  files.pathOf("");
  return 0;
}
