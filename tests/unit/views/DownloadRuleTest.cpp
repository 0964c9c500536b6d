#include "ZQVDownloadRule.h"

#include "PhoneTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

class DownloadRule : public PhoneTest {};

namespace {

constexpr const char* kNoNetwork =
    "IDS_MF_POP_MOBILE_DATA_IS_TURNED_OFF_CONNECT_TO_A_WI_FI_NETWORK_INSTEAD_MSG";
constexpr const char* kNoWifi =
    "IDS_RSH_TPOP_WI_FI_NOT_AVAILABLE_TURN_ON_WI_FI_OR_DESELECT_DOWNLOAD_VIA_WI_FI_ONLY";

}  // namespace

TEST_F(DownloadRule, AllowsAnyConnectionWithoutTheWifiWish) {
  for (const int type : {CONNECTION_TYPE_WIFI, CONNECTION_TYPE_CELLULAR, CONNECTION_TYPE_ETHERNET,
                         CONNECTION_TYPE_BT}) {
    phone.network = type;
    EXPECT_TRUE(zqvNetworkAllowsDownload(false)) << type;
  }
  EXPECT_THAT(phone.statusMessages, IsEmpty());
}

TEST_F(DownloadRule, SaysThatMobileDataIsOffWithoutAConnection) {
  phone.network = CONNECTION_TYPE_DISCONNECTED;
  EXPECT_FALSE(zqvNetworkAllowsDownload(false));
  EXPECT_THAT(phone.statusMessages, ElementsAre(kNoNetwork));
}

TEST_F(DownloadRule, WantsWifiItselfWithTheWifiWish) {
  phone.network = CONNECTION_TYPE_WIFI;
  EXPECT_TRUE(zqvNetworkAllowsDownload(true));
  for (const int type :
       {CONNECTION_TYPE_DISCONNECTED, CONNECTION_TYPE_CELLULAR, CONNECTION_TYPE_ETHERNET}) {
    phone.network = type;
    phone.statusMessages.clear();
    EXPECT_FALSE(zqvNetworkAllowsDownload(true)) << type;
    EXPECT_THAT(phone.statusMessages, ElementsAre(kNoWifi)) << type;
  }
}
