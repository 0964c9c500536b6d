#include <bundle.h>
#include <gtest/gtest.h>
#include <orlant_log_manager.h>

#include <filesystem>
#include <vector>

#include <common/Database.h>
#include "../platform/TestPhone.h"

namespace {

constexpr const char* kUri = "content://log/use_app_feature_survey";

struct Answer {
  int request = 0;
  int error = 1;
};

void replyCb(int request, int error, void* data) {
  static_cast<std::vector<Answer>*>(data)->push_back({request, error});
}

class TheUsageLog : public testing::Test {
 protected:
  TheUsageLog() {
    std::filesystem::create_directories(TestPhone::root() + "/dbspace");
    EXPECT_EQ(orlant_log_manager_create(&handle), ORLANT_LOG_ERROR_NONE);
    database()->execute("DELETE FROM record");
  }
  ~TheUsageLog() override { orlant_log_manager_destroy(handle); }

  static std::unique_ptr<common::Database> database() {
    return common::Database::open(TestPhone::root() + "/dbspace/usagelog.db", "SELECT 1");
  }

  int insert(const std::vector<std::pair<const char*, const char*>>& members, int* request) {
    bundle* data = bundle_create();
    for (const auto& [key, value] : members) bundle_add_str(data, key, value);
    const int error = orlant_log_manager_insert(handle, kUri, data, replyCb, &answers, request);
    bundle_free(data);
    return error;
  }

  orlant_log_manager_h handle = nullptr;
  std::vector<Answer> answers;
};

}  // namespace

TEST_F(TheUsageLog, StoresOneRowPerRecordInOrder) {
  insert({{"app_id", "com.orlant.zelqo"}, {"feature", "ZQ50"}, {"extra", "it's 100%s"}}, nullptr);
  insert({{"app_id", "com.orlant.zelqo"}, {"feature", "ZQ57"}}, nullptr);
  const auto reader = database();
  auto rows = reader->prepare("SELECT uri, app_id, feature, extra, time FROM record ORDER BY id");
  ASSERT_TRUE(rows.step());
  EXPECT_EQ(rows.text(0), kUri);
  EXPECT_EQ(rows.text(1), "com.orlant.zelqo");
  EXPECT_EQ(rows.text(2), "ZQ50");
  EXPECT_EQ(rows.text(3), "it's 100%s");
  EXPECT_GT(rows.number(4), 1600000000000);
  ASSERT_TRUE(rows.step());
  EXPECT_EQ(rows.text(2), "ZQ57");
  EXPECT_FALSE(rows.optionalText(3));
  EXPECT_FALSE(rows.step());
}

TEST_F(TheUsageLog, AnswersOnTheMainLoopWithTheNumberOfTheRequest) {
  int first = 0;
  int second = 0;
  ASSERT_EQ(insert({{"feature", "ZQ50"}}, &first), ORLANT_LOG_ERROR_NONE);
  ASSERT_EQ(insert({{"feature", "ZQ51"}}, &second), ORLANT_LOG_ERROR_NONE);
  EXPECT_TRUE(answers.empty());
  ASSERT_TRUE(waitUntil([this] { return answers.size() == 2; }));
  EXPECT_NE(first, second);
  EXPECT_EQ(answers[0].request, first);
  EXPECT_EQ(answers[1].request, second);
  EXPECT_EQ(answers[0].error, ORLANT_LOG_ERROR_NONE);
}

TEST_F(TheUsageLog, TellsARecordThatCannotBeStored) {
  database()->execute("DROP TABLE record");
  ASSERT_EQ(insert({{"feature", "ZQ50"}}, nullptr), ORLANT_LOG_ERROR_NONE);
  ASSERT_TRUE(waitUntil([this] { return !answers.empty(); }));
  EXPECT_EQ(answers[0].error, ORLANT_LOG_ERROR_STORE);
}

TEST_F(TheUsageLog, RefusesAMissingHandleAddressOrRecord) {
  bundle* data = bundle_create();
  int request = 0;
  EXPECT_EQ(orlant_log_manager_insert(nullptr, kUri, data, replyCb, &answers, &request),
            ORLANT_LOG_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(orlant_log_manager_insert(handle, nullptr, data, replyCb, &answers, &request),
            ORLANT_LOG_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(orlant_log_manager_insert(handle, kUri, nullptr, replyCb, &answers, &request),
            ORLANT_LOG_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(orlant_log_manager_create(nullptr), ORLANT_LOG_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(orlant_log_manager_destroy(nullptr), ORLANT_LOG_ERROR_INVALID_PARAMETER);
  settle();
  EXPECT_TRUE(answers.empty());
  bundle_free(data);
}

TEST_F(TheUsageLog, NeedsNoOneToAnswerTo) {
  bundle* data = bundle_create();
  EXPECT_EQ(orlant_log_manager_insert(handle, kUri, data, nullptr, nullptr, nullptr),
            ORLANT_LOG_ERROR_NONE);
  bundle_free(data);
  settle();
}
