#include <base/PhonePaths.h>

#include <cstdlib>

namespace base {

std::string phoneRoot() {
  const char* root = getenv("APPFW_ROOT");
  return root && *root ? root : "/opt/usr";
}

std::string databaseFolder() {
  return phoneRoot() + "/dbspace";
}

std::string applicationFolder(const std::string& appId) {
  const bool usable =
      !appId.empty() && appId != "." && appId != ".." && appId.find('/') == std::string::npos;
  return usable ? phoneRoot() + "/apps/" + appId + "/" : std::string();
}

}  // namespace base
