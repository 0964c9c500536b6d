#include <appfw/BusNames.h>
#include <appfw/CallerName.h>
#include <base/Bus.h>

namespace appfw {

CallerName::CallerName(const std::string& appId) : _bus(base::sessionBus()), _name(busName(appId)) {
  constexpr unsigned allowReplacement = 1;
  _valid = _bus && requestName(_bus.get(), _name, allowReplacement);
}

CallerName::~CallerName() {
  if (_valid) releaseName(_bus.get(), _name);
}

}  // namespace appfw
