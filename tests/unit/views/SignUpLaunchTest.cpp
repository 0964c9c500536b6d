#include "ZQVSignUpLaunch.h"

#include <app_control_internal.h>

#include "PhoneTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

class SignUpLaunch : public PhoneTest {
 protected:
  SignUpLaunch() {
    app_control_create(request.out());
    app_control_set_operation(request.get(), "http://tizen.org/appcontrol/operation/launch_viewer");
    app_control_add_extra_data(request.get(), "request_id", "7");
    launch.setLaunchRequest(request.get());
  }

  ZQVOwnedAppControl request;
  ZQVSignUpLaunch launch;
};

TEST_F(SignUpLaunch, ForwardsTheAuthenticationPageWithItsServer) {
  launch._launchOvu();
  ASSERT_EQ(phone.forwards.size(), 1u);
  EXPECT_EQ(phone.forwards[0].appId, "com.orlant.ovuport");
  EXPECT_EQ(phone.forwards[0].operation, "http://tizen.org/appcontrol/operation/auth");
  EXPECT_THAT(phone.forwards[0].server, ElementsAre("keld"));
  EXPECT_THAT(log.lines(), IsEmpty());
}

TEST_F(SignUpLaunch, ForwardsTheSettingsPageWithoutAServer) {
  launch._launchOvuSettingUi();
  ASSERT_EQ(phone.forwards.size(), 1u);
  EXPECT_EQ(phone.forwards[0].appId, "com.orlant.ovuport");
  EXPECT_EQ(phone.forwards[0].operation, "http://tizen.org/appcontrol/operation/setting");
  EXPECT_THAT(phone.forwards[0].server, IsEmpty());
  EXPECT_THAT(log.lines(), IsEmpty());
}

TEST_F(SignUpLaunch, AddsTheStartInformationOnlyAfterTheLaunch) {
  launch._launchOvuSettingUi();
  ASSERT_EQ(phone.forwards.size(), 1u);
  EXPECT_FALSE(phone.forwards[0].hasStartInfo);
  EXPECT_STREQ(bundle_get_val(phone.forwards[0].given, "__APP_SVC_START_INFO__"),
               "com.orlant.ovuport");
}

TEST_F(SignUpLaunch, LogsARefusedLaunch) {
  phone.launchErrors.forward = -13;
  launch._launchOvu();
  launch._launchOvuSettingUi();
  EXPECT_THAT(log.errors(), ElementsAre("app(com.orlant.ovuport) launch failed!",
                                        "app(com.orlant.ovuport) launch failed!"));
}

TEST_F(SignUpLaunch, StopsWithoutALaunchRequest) {
  launch.setLaunchRequest(nullptr);
  launch._launchOvu();
  launch._launchOvuSettingUi();
  EXPECT_THAT(log.errors(), ElementsAre("app_control_set_app_id error (-22)",
                                        "app_control_set_app_id error (-22)"));
  EXPECT_EQ(log.lines()[0].function, "_launchOvu");
  EXPECT_EQ(log.lines()[1].function, "_launchOvuSettingUi");
  EXPECT_THAT(phone.forwards, IsEmpty());
}

TEST_F(SignUpLaunch, StopsWhenTheOperationIsRefused) {
  const int before = phone.openRequests;
  phone.launchErrors.setOperation = -22;
  launch._launchOvu();
  launch._launchOvuSettingUi();
  EXPECT_THAT(log.errors(), ElementsAre("app_control_set_operation error (-22)",
                                        "app_control_set_operation error (-22)"));
  EXPECT_THAT(phone.forwards, IsEmpty());
  EXPECT_EQ(phone.openRequests, before) << "the clones are destroyed";
}

TEST_F(SignUpLaunch, StopsTheAuthenticationPageWhenTheLaunchModeIsRefused) {
  phone.launchErrors.setMode = -22;
  launch._launchOvu();
  EXPECT_THAT(log.errors(), ElementsAre("app_control_set_launch_mode error (-22)"));
  EXPECT_THAT(phone.forwards, IsEmpty());
}

TEST_F(SignUpLaunch, GivesTheSettingsPageNoLaunchMode) {
  phone.launchErrors.setMode = -22;
  launch._launchOvuSettingUi();
  EXPECT_EQ(phone.forwards.size(), 1u);
}

TEST_F(SignUpLaunch, DoesNotForwardTheAuthenticationPageAfterAnExportError) {
  phone.launchErrors.exportBundle = -12;
  launch._launchOvu();
  EXPECT_THAT(log.errors(), ElementsAre("app_control_export_as_bundle error (-12)"));
  EXPECT_THAT(phone.forwards, IsEmpty());
}

TEST_F(SignUpLaunch, ForwardsTheSettingsPageEvenAfterAnExportError) {
  launch._launchOvuSettingUi();
  phone.launchErrors.exportBundle = -12;
  launch._launchOvuSettingUi();
  EXPECT_THAT(log.errors(), ElementsAre("app_control_export_as_bundle error (-12)",
                                        "app(com.orlant.ovuport) launch failed!"));
  ASSERT_EQ(phone.forwards.size(), 2u);
  EXPECT_FALSE(phone.forwards[1].hasBundle) << "the bundle of the launch before is gone";
}

TEST_F(SignUpLaunch, KeepsItsOwnCloneOfTheRequest) {
  request.reset();
  launch._launchOvu();
  EXPECT_EQ(phone.forwards.size(), 1u);
}
