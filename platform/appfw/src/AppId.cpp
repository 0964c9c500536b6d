#include <appfw/AppId.h>
#include <common/Owned.h>

#include <cstdlib>

namespace appfw {
namespace {

/// …/apps/<id>/bin/<executable>
std::string idFromPath(const std::string& path) {
  const size_t bin = path.rfind("/bin/");
  if (bin == std::string::npos || bin == 0) return {};
  const size_t id = path.rfind('/', bin - 1);
  constexpr size_t parent = sizeof "/apps" - 1;
  if (id == std::string::npos || id < parent || path.compare(id - parent, parent, "/apps") != 0) {
    return {};
  }
  return path.substr(id + 1, bin - id - 1);
}

std::string findId() {
  const char* set = getenv("APPFW_APP_ID");
  if (set && *set) return set;
  common::OwnedText path(g_file_read_link("/proc/self/exe", nullptr));
  return path ? idFromPath(path.get()) : std::string();
}

}  // namespace

const std::string& applicationId() {
  static const std::string id = findId();
  return id;
}

}  // namespace appfw
