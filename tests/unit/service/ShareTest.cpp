#include <set>

#include "ServiceFixture.h"

namespace {

const std::vector<TestFile> kText = {{"a.txt", "text/plain", "0123456789"}};

using Share = ServiceTest;

TEST_F(Share, HasATokenThatNobodyGuesses) {
  std::set<std::string> tokens;
  for (int i = 0; i < 20; i++) tokens.insert(announce(kText).token);
  EXPECT_EQ(tokens.size(), 20U);
  for (const std::string& token : tokens) {
    EXPECT_EQ(token.size(), 40U);
    EXPECT_EQ(token.find_first_not_of("0123456789abcdef"), std::string::npos);
  }
}

TEST_F(Share, IsRecalledByItsSenderAlone) {
  const TestShare shared = share(kText);
  EXPECT_EQ(recall(shared, kBen).status, 403U);
  EXPECT_EQ(httpGet(address(shared, "file/0")).status, 200U);
  EXPECT_EQ(http("POST", url() + "/v1/shares/" + shared.id + "/recall").status, 401U);
  EXPECT_EQ(http("POST", url() + "/v1/shares/999/recall", {}, as(kAnna)).status, 404U);
}

TEST_F(Share, MayBeRecalledAgain) {
  const TestShare shared = share(kText);
  EXPECT_EQ(recall(shared).status, 200U);
  EXPECT_EQ(recall(shared).status, 200U);
  EXPECT_EQ(httpGet(address(shared, "file/0")).status, 410U);
}

TEST_F(Share, StaysRecalledAfterARestart) {
  const TestShare shared = share(kText);
  recall(shared);
  start();
  EXPECT_EQ(httpGet(address(shared, "file/0")).status, 410U);
}

TEST_F(Share, MayBeRecalledBeforeItIsComplete) {
  const TestShare draft = announce(kText);
  upload(draft, kText);
  EXPECT_EQ(recall(draft).status, 200U);
  EXPECT_EQ(complete(draft).status, 410U);
  EXPECT_EQ(httpGet(address(draft, "file/0")).status, 410U);
}

TEST_F(Share, IsCompleteOnce) {
  const TestShare shared = share(kText);
  EXPECT_EQ(complete(shared).status, 200U);
  EXPECT_EQ(poll(kBen, 0).number("cursor"), 1);
}

TEST_F(Share, NeedsAllItsFilesToBeComplete) {
  const TestShare draft = announce({{"a", "text/plain", "1"}, {"b", "text/plain", "2"}});
  upload(draft, {{"a", "text/plain", "1"}});
  EXPECT_EQ(complete(draft).status, 409U);
}

TEST_F(Share, LivesFromItsCompletionOn) {
  const TestShare draft = announce(kText, 1000);
  upload(draft, kText);
  const gint64 before = g_get_real_time() / 1000;
  const long long expires = complete(draft).number("expires_ms");
  EXPECT_GE(expires, before + 1000 * 1000);
  EXPECT_LE(expires, g_get_real_time() / 1000 + 1000 * 1000);
}

TEST_F(Share, KnowsNoOtherOperations) {
  const TestShare shared = share(kText);
  for (const char* path : {"/v1/shares/1", "/v1/shares/1/other", "/v1/other", "/v1",
                           "/v1/shares/x/recall", "/v1/subscribers/x/services/3"}) {
    EXPECT_EQ(http("POST", url() + path, "{}", as(kAnna)).status, 404U) << path;
  }
}

}  // namespace
