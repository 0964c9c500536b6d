#include "ZQVAccountCheck.h"

#include "PhoneTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

class AccountCheck : public PhoneTest {
 protected:
  ZQVAccountCheck check;
};

TEST_F(AccountCheck, PassesWithAnAccountWhoseServiceIsOn) {
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::Ok);
  EXPECT_THAT(phone.accountCalls,
              ElementsAre("open", "exists", "set 450051234567890", "status 2 cached", "close"));
  EXPECT_THAT(log.lines(), IsEmpty());
}

TEST_F(AccountCheck, FindsNoAccountWithoutAnImsi) {
  phone.imsi = nullptr;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::NoAccount);
  EXPECT_THAT(phone.accountCalls, ElementsAre("open", "exists"));
  EXPECT_THAT(log.lines(), IsEmpty());
}

TEST_F(AccountCheck, TakesAnythingButOnForOff) {
  for (const char* status : {"off", "ON", "on ", ""}) {
    phone.serviceStatus = status;
    EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::SharingIsOff) << status;
  }
}

TEST_F(AccountCheck, LogsAFailureToOpen) {
  phone.accountErrors.open = -5;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::NoAccount);
  EXPECT_THAT(phone.accountCalls, ElementsAre("open"));
  EXPECT_THAT(log.errors(), ElementsAre("ovu_open_handle failed [-5]"));
  EXPECT_EQ(log.lines()[0].function, "_checkOvuStatus");
}

TEST_F(AccountCheck, LogsAFailureToAskForTheAccount) {
  phone.accountErrors.exists = -22;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::NoAccount);
  EXPECT_THAT(phone.accountCalls, ElementsAre("open", "exists"));
  EXPECT_THAT(log.errors(), ElementsAre("ovu_exist_account_failed [-22]"));
  EXPECT_EQ(log.lines()[0].function, "_isOvuAccountExists");
}

TEST_F(AccountCheck, LogsAFailureToChooseTheAccount) {
  phone.accountErrors.setImsi = -61;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::NoAccount);
  EXPECT_THAT(log.errors(), ElementsAre("ovu_set_imsi failed [-61]"));
  EXPECT_THAT(phone.accountCalls, ElementsAre("open", "exists", "set 450051234567890"));
}

TEST_F(AccountCheck, CountsAsOffAndStaysOpenWhenTheServiceStatusFails) {
  phone.accountErrors.status = -5;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::SharingIsOff);
  EXPECT_THAT(log.errors(), ElementsAre("ovu_get_service_status failed [-5]",
                                        "share_check_ovu_service_status failed!"));
  EXPECT_EQ(log.lines()[0].function, "_checkOvuServiceStatus");
  EXPECT_THAT(phone.accountCalls,
              ElementsAre("open", "exists", "set 450051234567890", "status 2 cached"));
}

TEST_F(AccountCheck, LogsAMissingServiceStatusAndCloses) {
  phone.serviceStatus = nullptr;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::SharingIsOff);
  EXPECT_THAT(log.errors(), ElementsAre("service status is NULL"));
  EXPECT_EQ(phone.accountCalls.back(), "close");
}

TEST_F(AccountCheck, ReusesThePreviousPassWhenItCannotOpen) {
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::Ok);
  phone.accountErrors.open = -5;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::Ok);
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::Ok);
}

TEST_F(AccountCheck, ReusesThePreviousOffWhenItCannotOpen) {
  phone.serviceStatus = "off";
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::SharingIsOff);
  phone.accountErrors.open = -5;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::SharingIsOff);
}

TEST_F(AccountCheck, ForgetsThePassWhenTheAccountFails) {
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::Ok);
  phone.accountErrors.exists = -5;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::NoAccount);
  phone.accountErrors.open = -5;
  EXPECT_EQ(check._checkOvuStatus(), ZQVAccountCheck::NoAccount);
}

TEST_F(AccountCheck, LeavesNoHandleBehind) {
  phone.accountErrors.status = -5;
  {
    ZQVAccountCheck another;
    another._checkOvuStatus();
    another._checkOvuStatus();
  }
  EXPECT_EQ(std::count(phone.accountCalls.begin(), phone.accountCalls.end(), "open"),
            std::count(phone.accountCalls.begin(), phone.accountCalls.end(), "close"));
}
