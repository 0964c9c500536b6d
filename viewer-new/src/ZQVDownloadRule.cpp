#include "ZQVDownloadRule.h"

#include <net_connection.h>

#include "ZQVCommon.h"
#include "ZQVStatusMessage.h"

bool zqvNetworkAllowsDownload(bool isWifiOnly) {
  const int network = ZQViewerCommon::getInstance().zquiCommonCheckNetwork();
  if (isWifiOnly) {
    if (network == CONNECTION_TYPE_WIFI) return true;
    zqvPostStatusMessage(
        "IDS_RSH_TPOP_WI_FI_NOT_AVAILABLE_TURN_ON_WI_FI_OR_DESELECT_DOWNLOAD_VIA_WI_FI_ONLY");
    return false;
  }
  if (network != CONNECTION_TYPE_DISCONNECTED) return true;
  zqvPostStatusMessage(
      "IDS_MF_POP_MOBILE_DATA_IS_TURNED_OFF_CONNECT_TO_A_WI_FI_NETWORK_INSTEAD_MSG");
  return false;
}
