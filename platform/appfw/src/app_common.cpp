#include <app_common.h>
#include <appfw/AppId.h>
#include <base/Fault.h>
#include <base/PhonePaths.h>

#include <cstring>

namespace {

char* folder(const char* part) {
  const std::string root = base::applicationFolder(appfw::applicationId());
  return root.empty() ? nullptr : strdup((root + part).c_str());
}

}  // namespace

int app_get_id(char** id) {
  if (!id) return APP_ERROR_INVALID_PARAMETER;
  *id = nullptr;
  if (appfw::applicationId().empty()) return APP_ERROR_INVALID_CONTEXT;
  *id = strdup(appfw::applicationId().c_str());
  return *id ? APP_ERROR_NONE : APP_ERROR_OUT_OF_MEMORY;
}

char* app_get_resource_path() {
  if (base::strikes(__func__)) return nullptr;
  return folder("res/");
}

char* app_get_shared_resource_path() {
  if (base::strikes(__func__)) return nullptr;
  return folder("shared/res/");
}

char* app_get_data_path() {
  return folder("data/");
}

char* app_get_shared_data_path() {
  return folder("shared/data/");
}

char* app_get_cache_path() {
  return folder("cache/");
}

char* app_get_shared_trusted_path() {
  return folder("shared/trusted/");
}
