#include "FakeSettings.h"

#include <cstring>
#include <map>

namespace {

std::map<std::string, std::string>& settings() {
  static std::map<std::string, std::string> settings;
  return settings;
}

}  // namespace

void setServiceUrl(const std::string& url) {
  settings()["db/zelqo/service_url"] = url;
}

void setOwnNumber(const std::string& number) {
  settings()["db/zelqo/msisdn"] = number;
}

// In front of the settings library's.
extern "C" char* vconf_get_str(const char* key) {
  const auto found = settings().find(key);
  return found == settings().end() || found->second.empty() ? nullptr
                                                            : strdup(found->second.c_str());
}
