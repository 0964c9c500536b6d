// Where a downloaded file comes to lie: its name, the path that the shared list has for its
// address, and the content of a file that is in its place already, each ended by a zero byte.

#include "FileNamer.h"
#include "FilePlacer.h"
#include "Require.h"
#include "Texts.h"

#include <glib.h>
#include <sys/stat.h>

#include <cstdio>
#include <filesystem>
#include <fstream>

namespace {

namespace fs = std::filesystem;

/// A folder next to a file that is nobody's business.
class Downloads {
 public:
  Downloads() : _root(mkdtemp(_template)) {
    fs::create_directory(folder());
    std::ofstream(outside()) << "outside";
  }
  ~Downloads() { fs::remove_all(_root); }
  Downloads(const Downloads&) = delete;
  Downloads& operator=(const Downloads&) = delete;

  std::string folder() const { return _root + "/Downloads"; }
  std::string part() const { return folder() + "/.part"; }
  std::string outside() const { return _root + "/outside"; }

 private:
  char _template[32] = "/dev/shm/zelqo-fuzz-XXXXXX";
  std::string _root;
};

void requireSafe(const std::string& name) {
  require(!name.empty() && name.size() <= 255 && name[0] != '.');
  require(name.find('/') == std::string::npos && name.find('\0') == std::string::npos);
  require(g_utf8_validate(name.data(), static_cast<gssize>(name.size()), nullptr));
}

void write(const std::string& path, const std::string& content) {
  FILE* file = fopen(path.c_str(), "w");
  require(file && fwrite(content.data(), 1, content.size(), file) == content.size());
  fclose(file);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const Downloads downloads;
  const auto texts = textsOf(data, size, '\0', 3);
  const std::string safe = downloads::safeName(texts[0]);
  requireSafe(safe);
  requireSafe(downloads::numberedName(safe, 9999));
  require(downloads::safeName(safe) == safe);

  const std::string inTheWay = downloads.folder() + "/" + safe;
  write(inTheWay, texts[2]);
  write(downloads.part(), "new");
  const std::string earlier = texts[1].empty() ? "" : downloads.folder() + texts[1];
  const fs::path path =
      downloads::placeFile(downloads.part(), downloads.folder(), texts[0], earlier);
  require(path.parent_path() == downloads.folder());
  if (path.filename() != earlier.substr(std::min(earlier.size(), downloads.folder().size() + 1))) {
    requireSafe(path.filename());
  }
  require(fs::file_size(path) == 3 && fs::file_size(downloads.outside()) == 7);
  remove(path.c_str());
  remove(inTheWay.c_str());
  return 0;
}
