#include <common/Database.h>

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include "../platform/TestPhone.h"

namespace {

constexpr const char* kSchema = "CREATE TABLE IF NOT EXISTS t(k TEXT PRIMARY KEY, n INTEGER)";

std::string file(const char* name) {
  return TestPhone::root() + "/" + name;
}

}  // namespace

TEST(ADatabase, KeepsTextsNumbersAndNulls) {
  {
    auto database = common::Database::open(file("values.db"), kSchema);
    ASSERT_TRUE(database);
    const std::string text("a\0b", 3);
    EXPECT_TRUE(database->prepare("INSERT INTO t VALUES(?, ?)").bind(text).bind(1LL << 40).run());
    EXPECT_TRUE(database->prepare("INSERT INTO t VALUES('none', ?)")
                    .bind(std::optional<std::int64_t>())
                    .run());
  }
  auto database = common::Database::open(file("values.db"), kSchema);
  auto rows = database->prepare("SELECT k, n FROM t ORDER BY n DESC");
  ASSERT_TRUE(rows.step());
  EXPECT_EQ(rows.text(0), std::string("a\0b", 3));
  EXPECT_EQ(rows.number(1), 1LL << 40);
  ASSERT_TRUE(rows.step());
  EXPECT_FALSE(rows.optionalNumber(1));
  EXPECT_FALSE(rows.step());
  EXPECT_FALSE(rows.failed());
}

TEST(ADatabase, SaysThatAStatementFailed) {
  auto database = common::Database::open(file("failing.db"), kSchema);
  EXPECT_FALSE(database->prepare("SELECT nonsense").step());
  auto rows = database->prepare("SELECT nonsense");
  rows.step();
  EXPECT_TRUE(rows.failed());
  EXPECT_TRUE(database->prepare("INSERT INTO t VALUES('a', 1)").run());
  EXPECT_FALSE(database->prepare("INSERT INTO t VALUES('a', 2)").run());
}

TEST(ADatabase, IsNotOpenedInAFolderThatIsMissing) {
  EXPECT_FALSE(common::Database::open(file("missing/a.db"), kSchema));
}

TEST(ADatabase, IsNotOpenedOverAnotherKindOfFile) {
  writeFile(file("text.db"), std::string(8192, 'x'));
  EXPECT_FALSE(common::Database::open(file("text.db"), kSchema));
}

TEST(ADatabase, IsMadeByTwoProcessesAtOnce) {
  constexpr int kRounds = 10;
  for (int i = 0; i < kRounds; i++) {
    const std::string name = file(("both" + std::to_string(i)).c_str());
    const pid_t child = fork();
    if (child == 0) _exit(common::Database::open(name, kSchema) ? 0 : 1);
    EXPECT_TRUE(common::Database::open(name, kSchema));
    int status = -1;
    waitpid(child, &status, 0);
    EXPECT_EQ(status, 0);
  }
}
