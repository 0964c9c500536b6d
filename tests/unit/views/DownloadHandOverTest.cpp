#include "Items.h"
#include "PhoneTest.h"
#include "ZQVDownloadMgr.h"

using testing::ElementsAre;
using testing::IsEmpty;

class DownloadHandOver : public PhoneTest {
 protected:
  ZQViewerThumbnailItem& addChecked(const std::string& name, uint32_t size) {
    ZQViewerThumbnailItem& item = items.add(name, size);
    item.checked = true;
    return item;
  }
  void handOver(int32_t caller = ZQV_FROM_SELECT_VIEW, bool isWifiOnly = false,
                const char* sender = "Minji", const char* token = "token-1") {
    ZQVDownloadMgr(items.list(), isWifiOnly, caller, sender, token)._downloadMgrCreate();
  }
  std::vector<std::string> extra(const std::string& key) {
    return phone.launches.size() == 1 ? phone.launches[0].extra(key) : std::vector<std::string>();
  }

  Items items;
};

TEST_F(DownloadHandOver, LaunchesNothingWhenNothingIsChecked) {
  items.addCount(3);
  handOver();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(phone.usage, IsEmpty());
  EXPECT_THAT(log.errors(), ElementsAre("selected count error"));
  EXPECT_EQ(items[0].downloadStatus, ZQV_NOT_DOWNLOADED);
}

TEST_F(DownloadHandOver, LaunchesNothingForAnEmptyShare) {
  handOver();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(log.errors(), ElementsAre("selected count error"));
}

TEST_F(DownloadHandOver, LaunchesTheDownloadApplicationWithItsExtrasInOrder) {
  addChecked("a.jpg", 100);
  handOver();
  ASSERT_EQ(phone.launches.size(), 1u);
  const Launch& launch = phone.launches[0];
  EXPECT_EQ(launch.appId, "com.orlant.myfile-download-manager");
  EXPECT_EQ(launch.operation, APP_CONTROL_OPERATION_VIEW);
  EXPECT_THAT(launch.keys(), ElementsAre("remoteShare", "url", "name", "size", "token", "sender",
                                         "sender_icon", "all_downloaded", "wifi_check"));
  EXPECT_THAT(extra("remoteShare"), ElementsAre("download"));
  EXPECT_THAT(extra("url"), ElementsAre("http://service/share/t/file/0"));
  EXPECT_THAT(extra("name"), ElementsAre("a.jpg"));
  EXPECT_THAT(extra("token"), ElementsAre("token-1"));
  EXPECT_THAT(extra("sender"), ElementsAre("Minji"));
  EXPECT_THAT(extra("sender_icon"), ElementsAre(" "));
  EXPECT_THAT(extra("all_downloaded"), ElementsAre("0"));
  EXPECT_THAT(extra("wifi_check"), ElementsAre("0"));
  EXPECT_EQ(phone.openRequests, 0);
}

TEST_F(DownloadHandOver, CarriesExactlyTheCheckedFilesInListOrder) {
  addChecked("a.jpg", 100);
  items.add("b.jpg", 5);
  items.addNothing();
  addChecked("c.mp3", 200);
  addChecked("d.pdf", 300);
  handOver();
  EXPECT_THAT(extra("name"), ElementsAre("a.jpg", "c.mp3", "d.pdf"));
  EXPECT_THAT(extra("size"), ElementsAre("100", "200", "300"));
  EXPECT_THAT(phone.usageOf("ZQ51"), ElementsAre("Photo", "Audio", "Document"));
  EXPECT_THAT(phone.usageOf("ZQ53"), ElementsAre("0_100MB"));
}

TEST_F(DownloadHandOver, MarksTakenFilesAsRequestedAndLeavesTheChecks) {
  addChecked("a.jpg", 1);
  items.add("b.jpg", 1);
  addChecked("c.jpg", 1).downloadStatus = ZQV_DOWNLOADED;
  handOver();
  EXPECT_EQ(items[0].downloadStatus, ZQV_REQUESTED);
  EXPECT_EQ(items[1].downloadStatus, ZQV_NOT_DOWNLOADED);
  EXPECT_EQ(items[2].downloadStatus, ZQV_REQUESTED);
  EXPECT_TRUE(items[0].checked);
  EXPECT_TRUE(items[2].checked);
}

TEST_F(DownloadHandOver, TellsTheWifiChoice) {
  addChecked("a.jpg", 1);
  handOver(ZQV_FROM_SELECT_VIEW, true);
  EXPECT_THAT(extra("wifi_check"), ElementsAre("1"));
  EXPECT_THAT(extra("all_downloaded"), ElementsAre("0"));
  EXPECT_THAT(extra("sender_icon"), ElementsAre(" "));
}

TEST_F(DownloadHandOver, LeavesOutAnEmptyTokenAndSender) {
  addChecked("a.jpg", 1);
  handOver(ZQV_FROM_FULL_VIEW, false, nullptr, nullptr);
  ASSERT_EQ(phone.launches.size(), 1u);
  EXPECT_THAT(phone.launches[0].keys(), ElementsAre("remoteShare", "url", "name", "size",
                                                    "sender_icon", "all_downloaded", "wifi_check"));
}

TEST_F(DownloadHandOver, RepeatsTheLastKnownExtensionForANameWithoutOne) {
  addChecked("a.jpg", 1);
  addChecked("README", 1);
  addChecked("b.qqq", 1);
  addChecked("c.mp3", 1);
  handOver();
  EXPECT_THAT(phone.usageOf("ZQ51"), ElementsAre("Photo", "Photo", "Photo", "Audio"));
}

TEST_F(DownloadHandOver, CallsTheExtensionInvalidUntilTheFirstKnownOne) {
  addChecked("README", 1);
  addChecked("a.jpg", 1);
  handOver();
  EXPECT_THAT(phone.usageOf("ZQ51"), ElementsAre("Photo")) << "\"invalid\" has no category";
}

TEST_F(DownloadHandOver, TruncatesTheTotalToItsLow32Bits) {
  addChecked("a.mp4", 4294967295u);
  addChecked("b.mp4", 2);
  handOver();
  EXPECT_THAT(phone.usageOf("ZQ53"), ElementsAre("0_100MB")) << "4 GiB and one byte counts as one";
}

TEST_F(DownloadHandOver, RecordsTheLastFileForTheFullView) {
  addChecked("a.jpg", 100);
  addChecked("b.mp3", 104857600);
  handOver(ZQV_FROM_FULL_VIEW);
  EXPECT_THAT(extra("name"), ElementsAre("a.jpg", "b.mp3"));
  EXPECT_THAT(phone.usageOf("ZQ54"), ElementsAre("Audio"));
  EXPECT_THAT(phone.usageOf("ZQ55"), ElementsAre("100MB_500MB"));
  EXPECT_THAT(phone.usageOf("ZQ51"), IsEmpty());
  EXPECT_THAT(phone.usageOf("ZQ53"), IsEmpty());
}

TEST_F(DownloadHandOver, MarksFilesEvenWhenTheRequestCannotBeMade) {
  addChecked("a.jpg", 1);
  phone.launchErrors.create = APP_CONTROL_ERROR_OUT_OF_MEMORY;
  handOver();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_THAT(log.errors(), IsEmpty());
  EXPECT_EQ(items[0].downloadStatus, ZQV_REQUESTED);
}

TEST_F(DownloadHandOver, DoesNotLaunchWithoutApplicationOrOperation) {
  addChecked("a.jpg", 1);
  phone.launchErrors.setAppId = APP_CONTROL_ERROR_INVALID_PARAMETER;
  handOver();
  phone.launchErrors.setAppId = 0;
  phone.launchErrors.setOperation = APP_CONTROL_ERROR_INVALID_PARAMETER;
  handOver();
  EXPECT_THAT(phone.launches, IsEmpty());
  EXPECT_EQ(phone.openRequests, 0) << "the request is destroyed in every case";
}

TEST_F(DownloadHandOver, DropsTheErrorMessageOfAFailedReply) {
  addChecked("a.jpg", 1);
  handOver();
  ASSERT_NE(phone.launches[0].reply, nullptr);
  app_control_h reply = nullptr;
  app_control_create(&reply);
  app_control_add_extra_data(reply, "errorMessage", "disk full");
  phone.launches[0].reply(nullptr, reply, APP_CONTROL_RESULT_FAILED, nullptr);
  phone.launches[0].reply(nullptr, nullptr, APP_CONTROL_RESULT_FAILED, nullptr);
  phone.launches[0].reply(nullptr, reply, APP_CONTROL_RESULT_SUCCEEDED, nullptr);
  app_control_destroy(reply);
  EXPECT_THAT(phone.statusMessages, IsEmpty());
  EXPECT_EQ(items[0].downloadStatus, ZQV_REQUESTED);
}

TEST_F(DownloadHandOver, KeepsTheListsAlignedWhenAFileLacksItsAddress) {
  replaceText(&addChecked("a.jpg", 1).downloadUrl, nullptr);
  addChecked("b.jpg", 2);
  handOver();
  EXPECT_THAT(extra("url"), ElementsAre("", "http://service/share/t/file/1"));
  EXPECT_THAT(extra("name"), ElementsAre("a.jpg", "b.jpg"));
}

TEST_F(DownloadHandOver, HandsOverNamesAsTheyAre) {
  addChecked("100%s <b>&.jpg", 1);
  handOver();
  EXPECT_THAT(extra("name"), ElementsAre("100%s <b>&.jpg"));
}
