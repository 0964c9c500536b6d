#include <zelqo/Store.h>

#include <gtest/gtest.h>
#include <sqlite3.h>

#include <filesystem>
#include <fstream>

#include "TempFolder.h"
#include "TestShares.h"

namespace zelqo {
namespace {

class AStore : public testing::Test {
 protected:
  std::string path() const { return _folder.path("db/zelqo.db"); }
  int filesNamedDamaged() const {
    int count = 0;
    for (const auto& entry : std::filesystem::directory_iterator(_folder.path("db"))) {
      const std::string name = entry.path().filename();
      if (name.find(".damaged-") != std::string::npos && name.find("-wal") == std::string::npos &&
          name.find("-shm") == std::string::npos) {
        count++;
      }
    }
    return count;
  }
  void damage() const {
    std::filesystem::remove(path() + "-wal");
    std::filesystem::remove(path() + "-shm");
    std::ofstream(path(), std::ios::binary) << std::string(8192, 'x');
  }

 private:
  TempFolder _folder;
};

TEST_F(AStore, GivesBackWhatWasReceived) {
  Store store(path());
  ReceivedShare share = receivedShare("t1");
  share.files.push_back({});
  share.base = "https://cdn.example/share/t1";
  share.single = true;
  ASSERT_TRUE(store.addReceived(share));
  const auto found = store.received("t1");
  ASSERT_TRUE(found);
  EXPECT_EQ(found->sender, share.sender);
  EXPECT_EQ(found->base, share.base);
  EXPECT_TRUE(found->single);
  EXPECT_EQ(found->expiresMs, share.expiresMs);
  EXPECT_FALSE(found->recalledMs);
  ASSERT_EQ(found->files.size(), 3U);
  EXPECT_EQ(found->files[0].mid, "mid/0");
  EXPECT_EQ(found->files[1].size, 200);
  EXPECT_EQ(found->files[1].thumb, std::nullopt);
  EXPECT_EQ(found->files[2].name, std::nullopt);
  EXPECT_EQ(found->files[2].size, std::nullopt);
}

TEST_F(AStore, GivesBackWhatWasSent) {
  Store store(path());
  ASSERT_TRUE(store.addSent(sentShare(7, "t7")));
  const auto found = store.sent(7);
  ASSERT_TRUE(found);
  EXPECT_EQ(found->token, "t7");
  EXPECT_EQ(found->recipients, sentShare(7, "t7").recipients);
  EXPECT_EQ(found->paths, sentShare(7, "t7").paths);
  EXPECT_FALSE(store.sent(8));
}

TEST_F(AStore, KeepsOneRecordPerShare) {
  Store store(path());
  ASSERT_TRUE(store.addReceived(receivedShare("t1")));
  ReceivedShare again = receivedShare("t1");
  again.files.resize(1);
  ASSERT_TRUE(store.addReceived(again));
  EXPECT_EQ(store.received("t1")->files.size(), 1U);
  EXPECT_EQ(store.list().size(), 1U);
}

TEST_F(AStore, RemembersARecallWhenTheShareIsToldAgain) {
  Store store(path());
  ASSERT_TRUE(store.addReceived(receivedShare("t1")));
  ASSERT_TRUE(store.markRecalled("t1", 5000));
  ASSERT_TRUE(store.markRecalled("t1", 6000));
  ASSERT_TRUE(store.addReceived(receivedShare("t1")));
  EXPECT_EQ(store.received("t1")->recalledMs, 5000);
}

TEST_F(AStore, TakesARecallOfAnUnknownShare) {
  Store store(path());
  EXPECT_TRUE(store.markRecalled("t1", 5000));
  EXPECT_FALSE(store.received("t1"));
}

TEST_F(AStore, ListsTheNewestFirst) {
  Store store(path());
  store.addReceived(receivedShare("t1"));
  store.addSent(sentShare(7, "t7"));
  const auto list = store.list();
  ASSERT_EQ(list.size(), 2U);
  EXPECT_FALSE(list[0].received);
  EXPECT_EQ(list[0].requestId, 7);
  EXPECT_EQ(list[0].numbers.size(), 2U);
  EXPECT_EQ(list[0].firstFile, "/opt/usr/media/a.jpg");
  EXPECT_TRUE(list[1].received);
  EXPECT_EQ(list[1].fileCount, 2);
  EXPECT_EQ(list[1].firstFile, "a.jpg");
}

TEST_F(AStore, ForgetsWhatIsRemoved) {
  Store store(path());
  store.addReceived(receivedShare("t1"));
  store.addSent(sentShare(7, "t7"));
  EXPECT_TRUE(store.removeReceived("t1"));
  EXPECT_TRUE(store.removeSent(7));
  EXPECT_TRUE(store.list().empty());
}

TEST_F(AStore, SeesWhatAnotherOneWrites) {
  Store reader(path());
  EXPECT_FALSE(reader.received("t1"));
  Store writer(path());
  writer.addReceived(receivedShare("t1"));
  EXPECT_TRUE(reader.received("t1"));
}

TEST_F(AStore, KeepsAccountAndCursorApart) {
  Store store(path());
  EXPECT_EQ(store.accessKey("+1"), "");
  EXPECT_EQ(store.pushCursor("+1"), 0);
  EXPECT_TRUE(store.setPushCursor("+1", 42));
  EXPECT_TRUE(store.setAccessKey("+1", "key"));
  EXPECT_EQ(store.accessKey("+1"), "key");
  EXPECT_EQ(store.pushCursor("+1"), 42);
  EXPECT_EQ(store.pushCursor("+2"), 0);
}

TEST_F(AStore, MovesADamagedFileAsideAndGoesOn) {
  { EXPECT_TRUE(Store(path()).addReceived(receivedShare("t1"))); }
  damage();
  Store store(path());
  EXPECT_FALSE(store.received("t1"));
  EXPECT_TRUE(store.addReceived(receivedShare("t2")));
  EXPECT_TRUE(store.received("t2"));
  EXPECT_EQ(filesNamedDamaged(), 1);
}

TEST_F(AStore, NoticesDamageWhileItIsOpen) {
  Store store(path());
  for (int i = 0; i < 200; i++) {
    ASSERT_TRUE(store.addReceived(receivedShare("token" + std::to_string(i))));
  }
  // All pages but the first two, once they are in the main file.
  sqlite3* handle = nullptr;
  sqlite3_open(path().c_str(), &handle);
  sqlite3_exec(handle, "PRAGMA wal_checkpoint(TRUNCATE)", nullptr, nullptr, nullptr);
  sqlite3_close(handle);
  const auto size = std::filesystem::file_size(path());
  std::fstream file(path(), std::ios::in | std::ios::out | std::ios::binary);
  file.seekp(8192);
  file << std::string(size - 8192, '\xff');
  file.close();
  Store other(path());
  other.list();
  EXPECT_TRUE(other.addReceived(receivedShare("t2")));
  EXPECT_TRUE(other.received("t2"));
  EXPECT_TRUE(store.received("t2"));
}

TEST_F(AStore, FollowsWhenAnotherOneHasReplacedTheFile) {
  Store first(path());
  first.addReceived(receivedShare("t1"));
  std::filesystem::rename(path(), path() + ".gone");
  std::filesystem::remove(path() + "-wal");
  std::filesystem::remove(path() + "-shm");
  Store second(path());
  second.addReceived(receivedShare("t2"));
  EXPECT_FALSE(first.received("t1"));
  EXPECT_TRUE(first.received("t2"));
}

TEST_F(AStore, SaysThatItCannotBeUsed) {
  const TempFolder folder;
  Store store(folder.write("file", "") + "/zelqo.db");
  EXPECT_FALSE(store.usable());
  EXPECT_FALSE(store.addReceived(receivedShare("t1")));
  EXPECT_FALSE(store.received("t1"));
  EXPECT_TRUE(store.list().empty());
}

}  // namespace
}  // namespace zelqo
