#include "zelqo/PhoneSettings.h"

#include <vconf.h>

#include <cstdlib>
#include <memory>

namespace zelqo {
namespace {

struct Free {
  void operator()(char* text) const { free(text); }
};

std::string setting(const char* key) {
  const std::unique_ptr<char, Free> text(vconf_get_str(key));
  return text ? text.get() : "";
}

}  // namespace

std::string serviceUrl() {
  std::string url = setting("db/zelqo/service_url");
  while (!url.empty() && url.back() == '/') url.pop_back();
  return url;
}

std::string ownNumber() {
  return setting("db/zelqo/msisdn");
}

}  // namespace zelqo
