#include "zelqo/PhoneSettings.h"

#include <common/Owned.h>
#include <vconf.h>

#include <cstdlib>

namespace zelqo {
namespace {

std::string setting(const char* key) {
  const common::OwnedPlainText text(vconf_get_str(key));
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
