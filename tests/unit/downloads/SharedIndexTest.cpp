#include "SharedIndex.h"

#include <gtest/gtest.h>
#include <json-glib/json-glib.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <thread>

#include "TestFolder.h"

using downloads::SharedIndex;

namespace {

class Index : public testing::Test {
 protected:
  TestFolder folder;
  const std::string file = folder / "shared/data/index.json";
  SharedIndex index{file};
};

}  // namespace

TEST_F(Index, FindsWhatWasStored) {
  EXPECT_FALSE(index.find("http://a/1"));
  EXPECT_TRUE(index.set("http://a/1", "/x/one"));
  EXPECT_TRUE(index.set("http://a/2", "/x/two"));
  EXPECT_TRUE(index.set("http://a/1", "/x/uno"));
  EXPECT_EQ(index.find("http://a/1").value(), "/x/uno");
  EXPECT_EQ(index.find("http://a/2").value(), "/x/two");
}

TEST_F(Index, KeepsQuotesNewlinesAndLettersOfEveryScript) {
  const std::string path = "/x/\"quoted\"\n%s 사진.jpg";
  EXPECT_TRUE(index.set("http://a/?q=\"1\"&b=\\", path));
  EXPECT_EQ(index.find("http://a/?q=\"1\"&b=\\").value(), path);
}

TEST_F(Index, KeepsMembersThatOthersPutThere) {
  folder.write("index.json", R"({"other": 5, "http://a/1": "/x/one"})");
  SharedIndex shared(folder / "index.json");
  EXPECT_TRUE(shared.set("http://a/2", "/x/two"));
  EXPECT_EQ(shared.find("http://a/1").value(), "/x/one");
  EXPECT_FALSE(shared.find("other"));
  EXPECT_NE(TestFolder::read(folder / "index.json").find("\"other\""), std::string::npos);
}

TEST_F(Index, StartsAnewOverAFileThatIsNoIndex) {
  const std::string deep(1 << 20, '[');
  for (const std::string& garbage :
       {std::string(), std::string("{"), std::string("[1,2]"), std::string("null"),
        std::string("\xFF\xFE"), std::string("{\"a\":"), "{\"a\":" + deep,
        "{\"a\":/*\"*/" + deep}) {
    folder.write("index.json", garbage);
    SharedIndex shared(folder / "index.json");
    EXPECT_FALSE(shared.find("http://a/1"));
    EXPECT_TRUE(shared.set("http://a/1", "/x/one"));
    EXPECT_EQ(shared.find("http://a/1").value(), "/x/one");
  }
}

TEST_F(Index, WaitsForNobodyWhoPutAPipeInItsPlace) {
  ASSERT_EQ(mkfifo((folder / "index.json").c_str(), 0666), 0);
  SharedIndex shared(folder / "index.json");
  EXPECT_FALSE(shared.find("http://a/1"));
  EXPECT_TRUE(shared.set("http://a/1", "/x/one"));
  EXPECT_EQ(shared.find("http://a/1").value(), "/x/one");
}

TEST_F(Index, LosesNothingWhenTwoProcessesWriteAtOnce) {
  constexpr int kEach = 60;
  index.set("seed", "/x/seed");
  const pid_t child = fork();
  if (child == 0) {
    for (int i = 0; i < kEach; i++) index.set("child" + std::to_string(i), "/x/c");
    _exit(0);
  }
  for (int i = 0; i < kEach; i++) index.set("parent" + std::to_string(i), "/x/p");
  int status = -1;
  ASSERT_EQ(waitpid(child, &status, 0), child);
  ASSERT_EQ(status, 0);
  for (int i = 0; i < kEach; i++) {
    EXPECT_TRUE(index.find("child" + std::to_string(i)));
    EXPECT_TRUE(index.find("parent" + std::to_string(i)));
  }
}

TEST_F(Index, IsWholeWheneverSomebodyReadsIt) {
  index.set("seed", "/x/seed");
  std::atomic<bool> done{false};
  std::thread writer([&] {
    for (int i = 0; i < 100; i++) index.set("k" + std::to_string(i), std::string(500, 'v'));
    done = true;
  });
  int reads = 0;
  while (!done || reads == 0) {
    EXPECT_EQ(index.find("seed").value_or("gone"), "/x/seed");
    reads++;
  }
  writer.join();
}
