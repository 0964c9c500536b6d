#include <filesystem>

#include "ServiceFixture.h"

namespace {

const std::vector<TestFile> kText = {{"a.txt", "text/plain", "0123456789"}};

using ReadSide = ServiceTest;

TEST_F(ReadSide, ServesAFileByteForByte) {
  std::string bytes;
  for (int i = 0; i < 300000; i++) bytes += static_cast<char>(i * 7);
  const TestShare shared = share({{"a.bin", "application/octet-stream", bytes}});
  EXPECT_EQ(httpGet(address(shared, "file/0")).body, bytes);
}

TEST_F(ReadSide, ServesAnEmptyFile) {
  const TestShare shared = share({{"a.bin", "application/octet-stream", ""}});
  const HttpAnswer answer = httpGet(address(shared, "file/0"));
  EXPECT_EQ(answer.status, 200U);
  EXPECT_EQ(answer.body, "");
}

TEST_F(ReadSide, DescribesTheShareInItsManifest) {
  const HttpAnswer manifest = httpGet(address(share(kText), "manifest.json"));
  EXPECT_EQ(manifest.status, 200U);
  EXPECT_EQ(manifest.text("from"), kAnna);
  EXPECT_NE(manifest.body.find(R"({"name":"a.txt","size":10,"type":"text/plain","url":"file/0"})"),
            std::string::npos)
      << manifest.body;
}

TEST_F(ReadSide, ShowsNothingOfAShareBeforeItIsComplete) {
  const TestShare draft = announce(kText);
  upload(draft, kText);
  EXPECT_EQ(httpGet(address(draft, "file/0")).status, 404U);
  EXPECT_EQ(httpGet(address(draft, "manifest.json")).status, 404U);
}

TEST_F(ReadSide, AnswersAPartOfAFile) {
  const TestShare shared = share(kText);
  const HttpAnswer part = httpGet(address(shared, "file/0"), {{"Range", "bytes=2-4"}});
  EXPECT_EQ(part.status, 206U);
  EXPECT_EQ(part.body, "234");
  EXPECT_EQ(part.headers.at("Content-Range"), "bytes 2-4/10");
  const HttpAnswer rest = httpGet(address(shared, "file/0"), {{"Range", "bytes=7-"}});
  EXPECT_EQ(rest.body, "789");
}

TEST_F(ReadSide, RefusesAPartBeyondTheEnd) {
  const HttpAnswer answer = httpGet(address(share(kText), "file/0"), {{"Range", "bytes=10-"}});
  EXPECT_EQ(answer.status, 416U);
  EXPECT_EQ(answer.headers.at("Content-Range"), "bytes */10");
}

TEST_F(ReadSide, GivesTheRestOnlyOfTheSameContent) {
  const std::string file = address(share(kText), "file/0");
  const std::string tag = httpGet(file).headers.at("ETag");
  const HttpHeaders same = {{"Range", "bytes=5-"}, {"If-Range", tag}};
  const HttpHeaders other = {{"Range", "bytes=5-"}, {"If-Range", "\"other\""}};
  EXPECT_EQ(httpGet(file, same).body, "56789");
  const HttpAnswer whole = httpGet(file, other);
  EXPECT_EQ(whole.status, 200U);
  EXPECT_EQ(whole.body, kText[0].content);
}

TEST_F(ReadSide, SendsNothingThatTheReaderHas) {
  const std::string file = address(share(kText), "file/0");
  const std::string tag = httpGet(file).headers.at("ETag");
  EXPECT_EQ(httpGet(file, {{"If-None-Match", tag}}).status, 304U);
}

TEST_F(ReadSide, AnswersHeadWithoutABody) {
  const HttpAnswer answer = http("HEAD", address(share(kText), "file/0"));
  EXPECT_EQ(answer.status, 200U);
  EXPECT_EQ(answer.headers.at("Content-Length"), "10");
  EXPECT_EQ(answer.body, "");
}

TEST_F(ReadSide, IsReadOnly) {
  const TestShare shared = share(kText);
  EXPECT_EQ(http("PUT", address(shared, "file/0"), "x").status, 405U);
  EXPECT_EQ(http("DELETE", address(shared, "file/0")).status, 405U);
}

TEST_F(ReadSide, KnowsNoOtherAddresses) {
  const TestShare shared = share(kText);
  for (const char* path : {"", "file", "file/", "file/1", "file/00", "file/-1", "file/0/0",
                           "file/../manifest.json", "file/%2e%2e/manifest.json", "thumb/0",
                           "other/0", "manifest", "file/99999999999999999999"}) {
    const HttpAnswer answer = httpGet(address(shared, path));
    EXPECT_TRUE(answer.status == 404 || answer.body.find("\"token\"") != std::string::npos)
        << path << ": " << answer.status;
    EXPECT_NE(answer.body, kText[0].content) << path;
  }
  EXPECT_EQ(httpGet(url() + "/share/0000000000000000000000000000000000000000/file/0").status, 404U);
  EXPECT_EQ(httpGet(url() + "/").status, 404U);
  EXPECT_EQ(httpGet(url() + "/service.db").status, 404U);
}

TEST_F(ReadSide, AnswersGoneEverywhereAfterTheRecall) {
  const TestShare shared = share(kText);
  EXPECT_EQ(recall(shared).status, 200U);
  for (const char* path : {"manifest.json", "file/0", "thumb/0", "mid/0", "big/0", "file/7"}) {
    EXPECT_EQ(httpGet(address(shared, path)).status, 410U) << path;
  }
  EXPECT_FALSE(std::filesystem::exists(data("share/" + shared.token)));
}

TEST_F(ReadSide, AnswersGoneAfterTheExpiry) {
  const TestShare shared = share(kText, 1);
  EXPECT_TRUE(eventually([&] { return httpGet(address(shared, "file/0")).status == 410; }));
}

TEST_F(ReadSide, TakesAnExpiredShareFromTheDiskUnasked) {
  const TestShare shared = share(kText, 1);
  const std::string folder = data("share/" + shared.token);
  EXPECT_TRUE(std::filesystem::exists(folder));
  EXPECT_TRUE(eventually([&] { return !std::filesystem::exists(folder); }));
}

TEST_F(ReadSide, StillServesAfterARestart) {
  const TestShare shared = share(kText);
  EXPECT_EQ(service().stop(), 0);
  start();
  EXPECT_EQ(httpGet(address(shared, "file/0")).body, kText[0].content);
}

TEST_F(ReadSide, CountsWhatIsAskedFor) {
  const TestShare shared = share(kText);
  httpGet(address(shared, "file/0"));
  httpGet(address(shared, "file/0"), {{"Range", "bytes=5-"}});
  httpGet(address(shared, "thumb/0"));
  httpGet(address(shared, "manifest.json"));
  const HttpAnswer stats = httpGet(url() + "/v1/stats");
  EXPECT_EQ(stats.number("file"), 2);
  EXPECT_EQ(stats.number("file_bytes"), 15);
  EXPECT_EQ(stats.number("thumb"), 1);
  EXPECT_EQ(stats.number("mid"), 0);
  EXPECT_EQ(stats.number("manifest"), 1);
}

TEST_F(ReadSide, RefusesEverythingWhenToldTo) {
  const TestShare shared = share(kText);
  start({"--refuse"});
  EXPECT_EQ(httpGet(address(shared, "file/0")).status, 403U);
  EXPECT_EQ(recall(shared).status, 403U);
}

TEST_F(ReadSide, AnswersLateWhenToldTo) {
  const TestShare shared = share(kText);
  start({"--delay", "200"});
  const gint64 begin = g_get_monotonic_time();
  EXPECT_EQ(httpGet(address(shared, "file/0")).body, kText[0].content);
  EXPECT_GE(g_get_monotonic_time() - begin, 200 * 1000);
}

}  // namespace
