#include "FakeNetworkManager.h"
#include "KernelRoutes.h"
#include "TestPhone.h"

#include <net_connection.h>

namespace {

int currentType() {
  connection_h connection = nullptr;
  connection_type_e type = CONNECTION_TYPE_NET_PROXY;
  EXPECT_EQ(connection_create(&connection), CONNECTION_ERROR_NONE);
  EXPECT_EQ(connection_get_type(connection, &type), CONNECTION_ERROR_NONE);
  EXPECT_EQ(connection_destroy(connection), CONNECTION_ERROR_NONE);
  return type;
}

/// A kernel of its own: routes and interfaces in files.
class KernelRoutes : public testing::Test {
 protected:
  KernelRoutes() : _root(TestPhone::root() + "/kernel") {
    writeFile(_root + "/proc/net/route", kTitles);
    writeFile(_root + "/proc/net/ipv6_route", "");
  }
  void interface(const std::string& name, const std::string& type, const std::string& event) {
    writeFile(_root + "/sys/class/net/" + name + "/type", type + "\n");
    writeFile(_root + "/sys/class/net/" + name + "/uevent", event);
  }
  void routes(const std::string& lines) { writeFile(_root + "/proc/net/route", kTitles + lines); }

  const std::string kTitles =
      "Iface\tDestination\tGateway \tFlags\tRefCnt\tUse\tMetric\tMask\t\tMTU\tWindow\tIRTT\n";
  const std::string _root;
};

}  // namespace

TEST(Connection, ToleratesNoHandle) {
  connection_type_e type = CONNECTION_TYPE_WIFI;
  connection_h connection = nullptr;
  EXPECT_EQ(connection_create(nullptr), CONNECTION_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(connection_destroy(nullptr), CONNECTION_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(connection_get_type(nullptr, &type), CONNECTION_ERROR_INVALID_PARAMETER);
  connection_create(&connection);
  EXPECT_EQ(connection_get_type(connection, nullptr), CONNECTION_ERROR_INVALID_PARAMETER);
  connection_destroy(connection);
}

TEST(Connection, IsOfThePrimaryConnectionsType) {
  const struct {
    const char* name;
    int type;
  } cases[] = {{"802-11-wireless", CONNECTION_TYPE_WIFI},
               {"gsm", CONNECTION_TYPE_CELLULAR},
               {"cdma", CONNECTION_TYPE_CELLULAR},
               {"802-3-ethernet", CONNECTION_TYPE_ETHERNET},
               {"bluetooth", CONNECTION_TYPE_BT}};
  FakeNetworkManager manager;
  for (const auto& [name, type] : cases) {
    manager.set(manager.kManager,
                std::string("{'State': <@u 70>, 'PrimaryConnectionType': <'") + name + "'>}");
    EXPECT_EQ(currentType(), type) << name;
  }
}

TEST(Connection, IsNoneUntilThereIsAnAddress) {
  FakeNetworkManager manager;
  for (const char* state : {"0", "10", "20", "30", "40"}) {
    manager.set(manager.kManager, std::string("{'State': <@u ") + state +
                                      ">, 'PrimaryConnectionType': <'802-11-wireless'>}");
    EXPECT_EQ(currentType(), CONNECTION_TYPE_DISCONNECTED) << state;
  }
}

TEST(Connection, CountsWithoutReachingTheInternet) {
  FakeNetworkManager manager;
  manager.set(manager.kManager, "{'State': <@u 50>, 'PrimaryConnectionType': <'802-11-wireless'>}");
  EXPECT_EQ(currentType(), CONNECTION_TYPE_WIFI);
}

TEST(Connection, OfATunnelIsTheOneBelow) {
  FakeNetworkManager manager;
  manager.set(manager.kManager,
              "{'State': <@u 70>, 'PrimaryConnectionType': <'vpn'>,"
              "'ActiveConnections': <[objectpath '/a']>}");
  manager.set("/a", "{'Type': <'802-11-wireless'>}");
  EXPECT_EQ(currentType(), CONNECTION_TYPE_WIFI);
  manager.set("/a", "{'Type': <'vpn'>, 'Devices': <[objectpath '/d']>}");
  manager.set("/d", "{'DeviceType': <@u 8>}");
  EXPECT_EQ(currentType(), CONNECTION_TYPE_CELLULAR);
}

TEST(Connection, OfAnUnknownKindIsAConnectionAllTheSame) {
  FakeNetworkManager manager;
  manager.set(manager.kManager, "{'State': <@u 70>, 'PrimaryConnectionType': <'carrier-pigeon'>}");
  EXPECT_NE(currentType(), CONNECTION_TYPE_DISCONNECTED);
}

TEST(Connection, SurvivesPropertiesOfAnotherShape) {
  FakeNetworkManager manager;
  manager.set(manager.kManager,
              "{'State': <'connected'>, 'PrimaryConnectionType': <7>, 'ActiveConnections': <0>}");
  EXPECT_EQ(currentType(), CONNECTION_TYPE_DISCONNECTED);
}

TEST(Connection, IsTheKernelsWhenTheServiceIsSilentOrAbsent) {
  const int kernels = typeFromKernel("");
  EXPECT_EQ(currentType(), kernels);
  FakeNetworkManager manager;
  manager.fallSilent();
  EXPECT_EQ(currentType(), kernels);
}

TEST_F(KernelRoutes, WithoutADefaultRouteAreNoConnection) {
  EXPECT_EQ(typeFromKernel(_root), CONNECTION_TYPE_DISCONNECTED);
  routes("eth0\t0000A8C0\t00000000\t0001\t0\t0\t100\t00FFFFFF\t0\t0\t0\n");
  EXPECT_EQ(typeFromKernel(_root), CONNECTION_TYPE_DISCONNECTED);
}

TEST_F(KernelRoutes, LeaveByTheInterfaceWithTheLowestMetric) {
  interface("eth0", "1", "INTERFACE=eth0\n");
  interface("wlan0", "1", "DEVTYPE=wlan\nINTERFACE=wlan0\n");
  routes(
      "eth0\t00000000\t0101A8C0\t0003\t0\t0\t600\t00000000\t0\t0\t0\n"
      "wlan0\t00000000\t0101A8C0\t0003\t0\t0\t100\t00000000\t0\t0\t0\n");
  EXPECT_EQ(typeFromKernel(_root), CONNECTION_TYPE_WIFI);
}

TEST_F(KernelRoutes, KnowTheKindsOfInterface) {
  const struct {
    const char* type;
    const char* event;
    int expected;
  } cases[] = {{"1", "", CONNECTION_TYPE_ETHERNET},
               {"1", "DEVTYPE=wlan\n", CONNECTION_TYPE_WIFI},
               {"65534", "DEVTYPE=wwan\n", CONNECTION_TYPE_CELLULAR},
               {"512", "", CONNECTION_TYPE_CELLULAR},
               {"65534", "", CONNECTION_TYPE_ETHERNET}};
  routes("if0\t00000000\t0101A8C0\t0003\t0\t0\t100\t00000000\t0\t0\t0\n");
  for (const auto& [type, event, expected] : cases) {
    interface("if0", type, event);
    EXPECT_EQ(typeFromKernel(_root), expected) << type << event;
  }
}

TEST_F(KernelRoutes, IgnoreRejectedAndDownOnes) {
  interface("eth0", "1", "");
  routes(
      "eth0\t00000000\t00000000\t0203\t0\t0\t0\t00000000\t0\t0\t0\n"
      "eth0\t00000000\t00000000\t0002\t0\t0\t0\t00000000\t0\t0\t0\n"
      "garbage\n\n");
  EXPECT_EQ(typeFromKernel(_root), CONNECTION_TYPE_DISCONNECTED);
}

TEST_F(KernelRoutes, AreTheNewerProtocolsWhenTheOlderHasNone) {
  const std::string zeros(32, '0');
  interface("wlan0", "1", "DEVTYPE=wlan\n");
  writeFile(_root + "/proc/net/ipv6_route", zeros + " 00 " + zeros + " 00 " + zeros +
                                                " ffffffff 00000001 00000000 00200200 lo\n" +
                                                zeros + " 00 " + zeros + " 00 " + zeros +
                                                " 00000400 00000001 00000000 00000003 wlan0\n");
  EXPECT_EQ(typeFromKernel(_root), CONNECTION_TYPE_WIFI);
}
