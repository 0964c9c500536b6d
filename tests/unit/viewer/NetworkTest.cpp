#include <app_control.h>

#include "ViewerTest.h"
#include "ZQVCommon.h"

namespace {

constexpr const char* kUnable = "IDS_RSH_TPOP_UNABLE_TO_FIND_APPLICATION_TO_PERFORM_THIS_ACTION";

class Network : public ViewerTest {
 protected:
  static int check() { return ZQViewerCommon::getInstance().zquiCommonCheckNetwork(); }
};

TEST_F(Network, IsThePlatformsConnectionType) {
  for (int type : {0, 1, 2, 3, 4}) {
    platform().network = type;
    EXPECT_EQ(check(), type);
  }
  EXPECT_EQ(platform().connectionsDestroyed, 5);
}

TEST_F(Network, CountsAsDisconnectedWithoutAHandle) {
  platform().connectionCreateError = -12;
  EXPECT_EQ(check(), 0);
  EXPECT_EQ(errors(), Errors({"connection_create fail, ret_code = -12"}));
  EXPECT_EQ(platform().connectionsDestroyed, 1);
}

TEST_F(Network, CountsAsDisconnectedWhenTheTypeCannotBeRead) {
  platform().connectionTypeError = -38;
  EXPECT_EQ(check(), 0);
  EXPECT_EQ(errors(), Errors({"connection_get_type fail, ret_code = -38"}));
  EXPECT_EQ(platform().connectionsDestroyed, 1);
}

TEST_F(Network, LeavingNeedsAWindow) {
  ZQViewerCommon::getInstance().safeExit(nullptr);
  EXPECT_EQ(errors(), Errors({"winMain is NULL"}));
}

class Reshare : public ViewerTest {
 protected:
  void TearDown() override { EXPECT_EQ(phone().openRequests, 0); }
  static void reshare(const char* url, bool single) {
    ZQViewerCommon::getInstance().reshare(url, single);
  }
};

TEST_F(Reshare, AsksTheContactsPickerInThisOrder) {
  reshare("http://s/share/t", true);
  ASSERT_EQ(phone().launches.size(), 1u);
  const Launch& launch = phone().launches[0];
  EXPECT_EQ(launch.appId, "contacts-tabui-efl");
  EXPECT_EQ(launch.operation, APP_CONTROL_OPERATION_DEFAULT);
  EXPECT_EQ(launch.mode, APP_CONTROL_LAUNCH_MODE_SINGLE);
  EXPECT_EQ(launch.keys(), Errors({"type", "ct_max", "ct_app_id", "zq_reshare", "ct_operation"}));
  EXPECT_EQ(launch.extra("type"), Errors({"32"}));
  EXPECT_EQ(launch.extra("ct_max"), Errors({"10"}));
  EXPECT_EQ(launch.extra("ct_app_id"), Errors({"com.orlant.zelqo"}));
  EXPECT_EQ(launch.extra("zq_reshare"), Errors({"http://s/share/t"}));
  EXPECT_EQ(launch.extra("ct_operation"), Errors({APP_CONTROL_OPERATION_SHARE}));
  EXPECT_TRUE(platform().messages.empty());
}

TEST_F(Reshare, OfSeveralFilesAsksForAMultipleShare) {
  reshare("url", false);
  EXPECT_EQ(phone().launches[0].operation, APP_CONTROL_OPERATION_DEFAULT);
  EXPECT_EQ(phone().launches[0].extra("ct_operation"), Errors({APP_CONTROL_OPERATION_MULTI_SHARE}));
}

TEST_F(Reshare, OfNothingLaunchesNothing) {
  reshare(nullptr, true);
  EXPECT_TRUE(phone().launches.empty());
  EXPECT_TRUE(platform().messages.empty());
  EXPECT_EQ(errors(), Errors({"fileUrl is NULL"}));
}

TEST_F(Reshare, TellsTheUserWhenNobodyCanDoIt) {
  phone().launchErrors.send = APP_CONTROL_ERROR_APP_NOT_FOUND;
  reshare("url", true);
  EXPECT_EQ(platform().messages, Errors({kUnable}));
}

TEST_F(Reshare, StopsSilentlyAtTheFirstStepThatFails) {
  phone().launchErrors.create = -12;
  reshare("url", true);
  phone().launchErrors = {};
  phone().launchErrors.setAppId = -22;
  reshare("url", true);
  phone().launchErrors = {};
  phone().launchErrors.setOperation = -22;
  reshare("url", true);
  phone().launchErrors = {};
  phone().launchErrors.setMode = -22;
  reshare("url", true);
  phone().launchErrors = {};
  for (const char* key : {"type", "ct_max", "ct_app_id", "zq_reshare", "ct_operation"}) {
    platform().failingExtra = key;
    reshare("url", true);
  }
  EXPECT_TRUE(phone().launches.empty());
  EXPECT_TRUE(platform().messages.empty());
  EXPECT_TRUE(errors().empty());
}

TEST_F(Reshare, ReadsWhyThePickerFailedAndDropsIt) {
  reshare("url", true);
  app_control_h reply = nullptr;
  app_control_create(&reply);
  app_control_add_extra_data(reply, "errorMessage", "no contacts");
  phone().launches[0].reply(nullptr, reply, APP_CONTROL_RESULT_FAILED, nullptr);
  phone().launches[0].reply(nullptr, reply, APP_CONTROL_RESULT_SUCCEEDED, nullptr);
  app_control_destroy(reply);
  EXPECT_TRUE(platform().messages.empty());
}

}  // namespace
