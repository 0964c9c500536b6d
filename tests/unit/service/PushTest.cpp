#include <future>
#include <thread>

#include "ServiceFixture.h"

namespace {

const std::vector<TestFile> kText = {{"a.txt", "text/plain", "0123456789"}};

using Push = ServiceTest;

std::string kindOf(const HttpAnswer& push, guint index) {
  const Json json = parseJson(push.body);
  JsonArray* events = json_object_get_array_member(json_node_get_object(json.get()), "events");
  if (index >= json_array_get_length(events)) return "";
  return json_object_get_string_member(json_array_get_object_element(events, index), "kind");
}

TEST_F(Push, TellsTheRecipientWhatWasShared) {
  const TestShare shared = share(kText);
  const HttpAnswer push = poll(kBen, 0);
  EXPECT_EQ(push.status, 200U);
  EXPECT_EQ(kindOf(push, 0), "received");
  EXPECT_NE(push.body.find(shared.token), std::string::npos);
  EXPECT_NE(push.body.find("a.txt"), std::string::npos);
  EXPECT_EQ(push.headers.at("Push-Cursor"), std::to_string(push.number("cursor")));
}

TEST_F(Push, TellsNothingTwice) {
  share(kText);
  const HttpAnswer again = poll(kBen, poll(kBen, 0).number("cursor"));
  EXPECT_EQ(kindOf(again, 0), "");
  EXPECT_EQ(again.number("cursor"), 1);
}

TEST_F(Push, WakesWhoeverWaits) {
  as(kBen);
  auto waiting = std::async(std::launch::async, [this] { return poll(kBen, 0, 20); });
  const TestShare shared = share(kText);
  const HttpAnswer push = waiting.get();
  EXPECT_NE(push.body.find(shared.token), std::string::npos) << push.body;
}

TEST_F(Push, AnswersWithoutNewsWhenTheWaitIsOver) {
  const HttpAnswer push = poll(kBen, 0, 1);
  EXPECT_EQ(push.status, 200U);
  EXPECT_EQ(kindOf(push, 0), "");
  EXPECT_EQ(push.number("cursor"), 0);
}

TEST_F(Push, TellsBothSidesOfARecall) {
  const TestShare shared = share(kText);
  recall(shared);
  const HttpAnswer toBen = poll(kBen, 0);
  EXPECT_EQ(kindOf(toBen, 0), "received");
  EXPECT_EQ(kindOf(toBen, 1), "recalled");
  EXPECT_EQ(kindOf(poll(kAnna, 0), 0), "recalled");
}

TEST_F(Push, RemembersWhatWasToBeToldOverARestart) {
  const TestShare shared = share(kText);
  start();
  EXPECT_NE(poll(kBen, 0).body.find(shared.token), std::string::npos);
}

TEST_F(Push, IsForTheNumbersOwnerAlone) {
  as(kBen);
  const std::string number = "%2B" + kBen.substr(1);
  EXPECT_EQ(httpGet(url() + "/v1/push?msisdn=" + number + "&after=0").status, 401U);
  EXPECT_EQ(httpGet(url() + "/v1/push?msisdn=" + number + "&after=0", as(kAnna)).status, 403U);
  EXPECT_EQ(httpGet(url() + "/v1/push?msisdn=" + number, as(kBen)).status, 400U);
}

TEST_F(Push, NamesTheReadSideWhenItIsElsewhere) {
  start({"--public-url", "https://cdn.example"});
  const TestShare shared = share(kText);
  EXPECT_NE(poll(kBen, 0).body.find("\"base\":\"https://cdn.example/share/" + shared.token + "\""),
            std::string::npos);
}

TEST_F(Push, OfAShareThatExpiredOnTheWayStillArrives) {
  const TestShare shared = share(kText, 1);
  EXPECT_TRUE(eventually([&] { return httpGet(address(shared, "file/0")).status == 410; }));
  EXPECT_NE(poll(kBen, 0).body.find("a.txt"), std::string::npos);
}

TEST_F(Push, KeepsWaitingPhonesApart) {
  as(kBen);
  as(kAnna);
  auto anna = std::async(std::launch::async, [this] { return poll(kAnna, 0, 2); });
  const TestShare shared = share(kText);
  EXPECT_EQ(kindOf(anna.get(), 0), "");
}

TEST_F(Push, SurvivesPhonesThatHangUp) {
  as(kBen);
  for (int i = 0; i < 5; i++) {
    SoupSession* session = soup_session_new_with_options("timeout", 1, nullptr);
    SoupMessage* message = soup_message_new(
        "GET", (url() + "/v1/push?msisdn=%2B" + kBen.substr(1) + "&after=0").c_str());
    soup_message_headers_replace(soup_message_get_request_headers(message), "Authorization",
                                 as(kBen)[0].second.c_str());
    GCancellable* cancellable = g_cancellable_new();
    std::thread hangUp([cancellable] {
      g_usleep(20000);
      g_cancellable_cancel(cancellable);
    });
    EXPECT_EQ(soup_session_send(session, message, cancellable, nullptr), nullptr);
    hangUp.join();
    g_object_unref(cancellable);
    g_object_unref(message);
    g_object_unref(session);
  }
  const TestShare shared = share(kText);
  EXPECT_NE(poll(kBen, 0).body.find(shared.token), std::string::npos);
}

}  // namespace
