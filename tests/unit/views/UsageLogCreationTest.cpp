// A program of its own: the usage log is created once per process.
#include "PhoneTest.h"
#include "ZQVOrlantLog.h"

using testing::ElementsAre;

class UsageLogCreation : public PhoneTest {};

TEST_F(UsageLogCreation, IsTriedAgainOnEveryUseUntilItWorks) {
  phone.usageCreateError = -5;
  ZQVOrlantLog::getInstance();
  EXPECT_EQ(phone.usageCreateCalls, 1);
  EXPECT_THAT(log.errors(), ElementsAre("orlant_log_manager_create failed"));

  ZQVOrlantLog::getInstance().insertRecall();
  EXPECT_EQ(phone.usageCreateCalls, 2);
  EXPECT_EQ(log.count("orlant_log_manager_create failed"), 2);
  ASSERT_EQ(phone.usage.size(), 1u) << "a missing handle is passed on as it is";
  EXPECT_FALSE(phone.usage[0].hasHandle);

  phone.usageCreateError = 0;
  ZQVOrlantLog::getInstance().insertRecall();
  EXPECT_EQ(phone.usageCreateCalls, 3);
  EXPECT_TRUE(phone.usage[1].hasHandle);

  ZQVOrlantLog::getInstance().insertRecall();
  EXPECT_EQ(phone.usageCreateCalls, 3);
}
