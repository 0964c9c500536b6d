#include "TestPhone.h"

#include <app_common.h>

TEST(AppPaths, EndInASlashBelowTheApplicationsFolder) {
  const std::string folder = TestPhone::root() + "/apps/" + TestPhone::kAppId + "/";
  EXPECT_EQ(take(app_get_resource_path()), folder + "res/");
  EXPECT_EQ(take(app_get_shared_resource_path()), folder + "shared/res/");
  EXPECT_EQ(take(app_get_data_path()), folder + "data/");
  EXPECT_EQ(take(app_get_shared_data_path()), folder + "shared/data/");
}

TEST(AppId, IsTheRunningApplications) {
  char* id = nullptr;
  EXPECT_EQ(app_get_id(&id), APP_ERROR_NONE);
  EXPECT_EQ(take(id), TestPhone::kAppId);
  EXPECT_EQ(app_get_id(nullptr), APP_ERROR_INVALID_PARAMETER);
}
