#include <zelqo/Push.h>

#include <gtest/gtest.h>

namespace zelqo {
namespace {

const char kToken[] = "0123456789abcdef0123456789abcdef01234567";

std::string received(const std::string& share) {
  return std::string(R"({"cursor":3,"events":[{"id":3,"kind":"received","token":")") + kToken +
         R"(","share":)" + share + "}]}";
}

TEST(APush, TellsWhatWasReceived) {
  const auto push = readPush(received(
      R"({"from":"+82101","single":true,"created_ms":1,"expires_ms":9,"files":[
          {"name":"a","size":5,"type":"image/png","url":"file/0","thumb":"thumb/0"},{},7]})"));
  ASSERT_TRUE(push);
  EXPECT_EQ(push->cursor, 3);
  ASSERT_EQ(push->events.size(), 1U);
  const ReceivedShare& share = push->events[0].share;
  EXPECT_EQ(share.token, kToken);
  EXPECT_EQ(share.sender, "+82101");
  EXPECT_TRUE(share.single);
  EXPECT_EQ(share.expiresMs, 9);
  ASSERT_EQ(share.files.size(), 3U);
  EXPECT_EQ(share.files[0].thumb, "thumb/0");
  EXPECT_EQ(share.files[0].mid, std::nullopt);
  EXPECT_EQ(share.files[2].name, std::nullopt);
}

TEST(APush, TellsWhatWasRecalled) {
  const auto push = readPush(std::string(R"({"cursor":4,"events":[{"kind":"recalled","token":")") +
                             kToken + "\"}]}");
  ASSERT_TRUE(push);
  ASSERT_EQ(push->events.size(), 1U);
  EXPECT_EQ(push->events[0].kind, PushEvent::Kind::Recalled);
}

TEST(APush, LeavesOutEventsThatMakeNoSense) {
  for (
      const std::string& event : std::vector<std::string>{
          "1", "{}", R"({"kind":"received"})", R"({"kind":"other","token":"0123456789abcdef"})",
          R"({"kind":"recalled","token":"short"})",
          R"({"kind":"recalled","token":"../../../../etc/passwd"})",
          R"({"kind":"received","token":"0123456789abcdef","share":[]})",
          R"({"kind":"received","token":"0123456789abcdef","share":{}})",
          R"({"kind":"received","token":"0123456789abcdef","share":{"from":1,"expires_ms":1,"files":[]}})",
          R"({"kind":"received","token":"0123456789abcdef","share":{"from":"","expires_ms":1,"files":[]}})",
          R"({"kind":"received","token":"0123456789abcdef","share":{"from":"1","expires_ms":"x","files":[]}})",
          R"({"kind":"received","token":"0123456789abcdef","share":{"from":"1","expires_ms":1}})"}) {
    const auto push = readPush(R"({"cursor":4,"events":[)" + event + "]}");
    ASSERT_TRUE(push) << event;
    EXPECT_TRUE(push->events.empty()) << event;
    EXPECT_EQ(push->cursor, 4);
  }
}

TEST(APush, IsNothingElse) {
  for (const std::string& text : std::vector<std::string>{
           "", "x", "[]", "{}", R"({"events":[]})", R"({"cursor":1})",
           R"({"cursor":-1,"events":[]})", R"({"cursor":"1","events":[]})",
           R"({"cursor":1,"events":{}})", std::string(1 << 20, '['),
           R"({"a":)" + std::string(1 << 20, '['), "{\"\xff\":1}",
           R"({"cursor":1,"events":[]}{"cursor":1,"events":[]})", R"({"cursor":1,"events":[]},{})",
           R"(1{"cursor":1,"events":[]})", R"({"a":/*"*/)" + std::string(1 << 20, '['),
           R"({"a":'"',"b":)" + std::string(1 << 20, '[')}) {
    EXPECT_FALSE(readPush(text)) << text.substr(0, 40);
  }
}

TEST(APush, MayEscapeItsLetters) {
  const auto push = readPush(
      received(R"({"from":"1","expires_ms":1,"files":[{"name":"\ud83d\uDE00 \\ud83d"}]})"));
  ASSERT_TRUE(push);
  EXPECT_EQ(push->events[0].share.files[0].name, "\xF0\x9F\x98\x80 \\ud83d");
}

TEST(APush, LosesWhatIsTooLongAndKeepsTheRest) {
  const auto push = readPush(received(R"({"from":"1","expires_ms":1,"files":[{"name":")" +
                                      std::string(10000, 'x') + R"(","size":-5,"type":"t"}]})"));
  ASSERT_TRUE(push);
  ASSERT_EQ(push->events.size(), 1U);
  EXPECT_EQ(push->events[0].share.files[0].name, std::nullopt);
  EXPECT_EQ(push->events[0].share.files[0].size, std::nullopt);
  EXPECT_EQ(push->events[0].share.files[0].type, "t");
}

}  // namespace
}  // namespace zelqo
