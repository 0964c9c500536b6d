#include "KernelRoutes.h"

#include <fstream>
#include <limits>
#include <sstream>

#include <unistd.h>

namespace {

constexpr unsigned kRouteUp = 0x1, kRouteReject = 0x200;

struct Route {
  std::string interface;
  unsigned metric = std::numeric_limits<unsigned>::max();
};

void keepBetter(Route& best, const std::string& interface, unsigned flags, unsigned metric) {
  const bool usable = (flags & kRouteUp) && !(flags & kRouteReject) && interface != "lo";
  if (usable && (best.interface.empty() || metric < best.metric)) best = {interface, metric};
}

Route defaultRoute4(const std::string& root) {
  std::ifstream file(root + "/proc/net/route");
  std::string line;
  Route best;
  std::getline(file, line);  // the column titles
  while (std::getline(file, line)) {
    std::istringstream columns(line);
    std::string interface, destination, gateway, mask;
    unsigned flags = 0, references = 0, uses = 0, metric = 0;
    columns >> interface >> destination >> gateway >> std::hex >> flags >> std::dec >> references >>
        uses >> metric >> mask;
    if (columns && destination == "00000000" && mask == "00000000") {
      keepBetter(best, interface, flags, metric);
    }
  }
  return best;
}

Route defaultRoute6(const std::string& root) {
  std::ifstream file(root + "/proc/net/ipv6_route");
  std::string line;
  Route best;
  while (std::getline(file, line)) {
    std::istringstream columns(line);
    std::string destination, length, source, sourceLength, gateway, interface;
    unsigned metric = 0, references = 0, uses = 0, flags = 0;
    columns >> destination >> length >> source >> sourceLength >> gateway >> std::hex >> metric >>
        references >> uses >> flags >> interface;
    if (columns && length == "00" && destination.find_first_not_of('0') == std::string::npos) {
      keepBetter(best, interface, flags, metric);
    }
  }
  return best;
}

std::string contents(const std::string& path) {
  std::ifstream file(path);
  std::ostringstream text;
  text << file.rdbuf();
  return text.str();
}

connection_type_e typeOfInterface(const std::string& folder) {
  constexpr int pointToPoint = 512;
  const std::string event = contents(folder + "/uevent");
  const auto is = [&event](const char* type) { return event.find(type) != std::string::npos; };
  if (access((folder + "/phy80211").c_str(), F_OK) == 0 || is("DEVTYPE=wlan")) {
    return CONNECTION_TYPE_WIFI;
  }
  if (is("DEVTYPE=wwan") || contents(folder + "/type") == std::to_string(pointToPoint) + '\n') {
    return CONNECTION_TYPE_CELLULAR;
  }
  if (is("DEVTYPE=bluetooth")) return CONNECTION_TYPE_BT;
  // Also for tunnels and the like: they are a connection.
  return CONNECTION_TYPE_ETHERNET;
}

}  // namespace

connection_type_e typeFromKernel(const std::string& root) {
  Route route = defaultRoute4(root);
  if (route.interface.empty()) route = defaultRoute6(root);
  if (route.interface.empty()) return CONNECTION_TYPE_DISCONNECTED;
  return typeOfInterface(root + "/sys/class/net/" + route.interface);
}
