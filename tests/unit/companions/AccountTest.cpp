#include <AccountStore.h>
#include <SimCard.h>
#include <gtest/gtest.h>
#include <ovu.h>

#include <filesystem>

#include "../platform/TestPhone.h"
#include "FakeModem.h"

namespace {

class TheAccount : public testing::Test {
 protected:
  TheAccount() {
    std::filesystem::create_directories(TestPhone::root() + "/dbspace");
    ovu::AccountStore().remove();
    EXPECT_EQ(ovu_open_handle(&handle), OVU_ERROR_NONE);
  }
  ~TheAccount() override { EXPECT_EQ(ovu_close_handle(handle), OVU_ERROR_NONE); }

  std::string imsi() {
    char* imsi = nullptr;
    EXPECT_EQ(ovu_check_account_exist(handle, &imsi, nullptr), OVU_ERROR_NONE);
    return take(imsi);
  }

  std::string status() {
    char* status = nullptr;
    EXPECT_EQ(ovu_get_service_status(handle, OVU_SERVICE_SHARE, &status, 1), OVU_ERROR_NONE);
    return take(status);
  }

  ovu_h handle = nullptr;
};

}  // namespace

TEST_F(TheAccount, DoesNotExistBeforeSigningUp) {
  EXPECT_EQ(imsi(), "(null)");
  EXPECT_EQ(ovu_set_imsi(handle, "450050123456789"), OVU_ERROR_NO_ACCOUNT);
  char* status = nullptr;
  EXPECT_EQ(ovu_get_service_status(handle, OVU_SERVICE_SHARE, &status, 1), OVU_ERROR_NO_ACCOUNT);
  EXPECT_EQ(status, nullptr);
}

TEST_F(TheAccount, ExistsWithTheServiceOnOnceSignedUp) {
  ASSERT_TRUE(ovu::AccountStore().signUp("+821012345678", "450050123456789"));
  char* number = nullptr;
  char* identity = nullptr;
  ASSERT_EQ(ovu_check_account_exist(handle, &identity, &number), OVU_ERROR_NONE);
  EXPECT_EQ(take(identity), "450050123456789");
  EXPECT_EQ(take(number), "+821012345678");
  ASSERT_EQ(ovu_set_imsi(handle, "450050123456789"), OVU_ERROR_NONE);
  EXPECT_EQ(status(), "on");
}

TEST_F(TheAccount, FollowsTheSwitchOfTheService) {
  ovu::AccountStore store;
  ASSERT_TRUE(store.signUp("+821012345678", "450050123456789"));
  ASSERT_EQ(ovu_set_imsi(handle, "450050123456789"), OVU_ERROR_NONE);
  ASSERT_TRUE(store.switchService(OVU_SERVICE_SHARE, false));
  EXPECT_EQ(status(), "off");
  ASSERT_TRUE(store.switchService(OVU_SERVICE_SHARE, true));
  EXPECT_EQ(status(), "on");
}

TEST_F(TheAccount, KnowsOnlyItsOwnIdentity) {
  ASSERT_TRUE(ovu::AccountStore().signUp("+821012345678", "450050123456789"));
  EXPECT_EQ(ovu_set_imsi(handle, "1"), OVU_ERROR_NO_ACCOUNT);
}

TEST_F(TheAccount, TakesItsIdentityFromTheSimCard) {
  const FakeModem modem("310150987654321");
  EXPECT_EQ(ovu::simCardImsi(), "310150987654321");
  ASSERT_TRUE(ovu::AccountStore().signUp("+821012345678"));
  EXPECT_EQ(imsi(), "310150987654321");
}

TEST_F(TheAccount, MakesAnIdentityOfTheNumberWithoutASimCard) {
  const FakeModem modem("");
  EXPECT_EQ(ovu::simCardImsi(), "");
  ASSERT_TRUE(ovu::AccountStore().signUp("+82-10-1234-5678"));
  EXPECT_EQ(imsi(), "000821012345678");
}

TEST_F(TheAccount, MakesAnIdentityOfTheNumberWithoutAModem) {
  ASSERT_TRUE(ovu::AccountStore().signUp("+821012345678"));
  EXPECT_EQ(imsi(), "000821012345678");
}

TEST_F(TheAccount, ForgetsItsServicesWhenItIsRemoved) {
  ovu::AccountStore store;
  ASSERT_TRUE(store.signUp("+821012345678", "450050123456789"));
  ASSERT_TRUE(store.remove());
  EXPECT_EQ(imsi(), "(null)");
  EXPECT_FALSE(store.isServiceOn(OVU_SERVICE_SHARE));
}

TEST_F(TheAccount, RefusesMissingArguments) {
  char* text = nullptr;
  EXPECT_EQ(ovu_open_handle(nullptr), OVU_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(ovu_check_account_exist(nullptr, &text, &text), OVU_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(ovu_check_account_exist(handle, nullptr, &text), OVU_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(ovu_set_imsi(handle, nullptr), OVU_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(ovu_get_service_status(handle, nullptr, &text, 1), OVU_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(ovu_close_handle(nullptr), OVU_ERROR_INVALID_PARAMETER);
}

TEST(AnAccountStore, ThatCannotBeOpenedFailsEverywhere) {
  ovu::AccountStore store(TestPhone::root() + "/missing/account.db");
  bool failed = false;
  EXPECT_FALSE(store.isOpen());
  EXPECT_FALSE(store.account(&failed));
  EXPECT_TRUE(failed);
  EXPECT_FALSE(store.signUp("+821012345678", "1"));
  EXPECT_FALSE(store.switchService(OVU_SERVICE_SHARE, true));
}
