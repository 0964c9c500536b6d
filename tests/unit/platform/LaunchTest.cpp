// Launches between processes.
#include "ReceivedRequests.h"

#include <app_control_internal.h>
#include <appfw/CallerName.h>
#include <appfw/Launch.h>
#include <aul.h>
#include <base/Fault.h>
#include <json-glib/json-glib.h>

#include <cstdio>
#include <cstring>
#include <map>

// In place of the phone's programs: one that opens every file.
namespace mime {
bool resolver_can_open(const char* uri);
bool resolver_can_open(const char* uri) {
  return *uri == '/';
}
}  // namespace mime

namespace {

bool bundlesFail = false;

}  // namespace

// In place of the plan that the environment gives: bundles that cannot be made.
bool base::strikes(const char* call) {
  return bundlesFail && strcmp(call, "bundle_create") == 0;
}

namespace {

constexpr const char* kCallee = "test.callee";

class ALaunch : public testing::Test {
 protected:
  ALaunch() {
    app_control_create(&_request);
    app_control_set_app_id(_request, kCallee);
    std::remove(starts().c_str());
    TestPhone::install(kCallee, std::string(CALLEE) + " " + starts());
  }

  ~ALaunch() override {
    bundlesFail = false;
    // The next test wants a callee that is not running.
    if (!readFile(starts()).empty()) quitCallee();
    app_control_destroy(_request);
  }

  static std::string starts() { return TestPhone::root() + "/starts"; }
  static std::string record() { return readFile(TestPhone::root() + "/dbspace/launches.jsonl"); }

  static void replyCb(app_control_h request, app_control_h reply, app_control_result_e result,
                      void* data) {
    auto* self = static_cast<ALaunch*>(data);
    self->_replies++;
    self->_result = result;
    self->_requestSeen = ReceivedRequests::extra(request, "do");
    self->_replyKeys = ReceivedRequests::extraKeys(reply);
    self->_reply.clear();
    for (const auto& key : self->_replyKeys) {
      self->_reply[key] = ReceivedRequests::extra(reply, key.c_str());
    }
  }

  int send(const char* task) {
    app_control_add_extra_data(_request, "do", task);
    return app_control_send_launch_request(_request, replyCb, this);
  }

  bool waitForReply() {
    const int before = _replies;
    return waitUntil([&] { return _replies > before; });
  }

  void quitCallee() {
    app_control_destroy(_request);
    app_control_create(&_request);
    app_control_set_app_id(_request, kCallee);
    ASSERT_EQ(send("quit"), APP_CONTROL_ERROR_NONE);
    EXPECT_TRUE(waitForReply());
  }

  app_control_h _request = nullptr;
  int _replies = 0;
  app_control_result_e _result = APP_CONTROL_RESULT_APP_STARTED;
  std::string _requestSeen;
  std::vector<std::string> _replyKeys;
  std::map<std::string, std::string> _reply;
};

}  // namespace

TEST_F(ALaunch, OfAnUnknownApplicationIsNotFound) {
  app_control_set_app_id(_request, "test.nobody");
  EXPECT_EQ(send("reply"), APP_CONTROL_ERROR_APP_NOT_FOUND);
  app_control_set_app_id(_request, "not/an id at all\n");
  EXPECT_EQ(send("reply"), APP_CONTROL_ERROR_APP_NOT_FOUND);
  EXPECT_EQ(_replies, 0);
}

TEST_F(ALaunch, WithTheDefaultOperationNeedsAnApplication) {
  app_control_set_app_id(_request, nullptr);
  EXPECT_EQ(send("reply"), APP_CONTROL_ERROR_APP_NOT_FOUND);
}

TEST_F(ALaunch, StartsTheApplicationAndBringsItsReply) {
  const char* list[] = {"one", "two"};
  app_control_set_operation(_request, APP_CONTROL_OPERATION_SHARE);
  app_control_add_extra_data_array(_request, "list", list, 2);
  app_control_add_extra_data(_request, "after", "x");
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  app_control_destroy(_request);  // the launch keeps its own copy
  ASSERT_TRUE(waitForReply());
  app_control_create(&_request);
  EXPECT_EQ(_result, APP_CONTROL_RESULT_SUCCEEDED);
  EXPECT_EQ(_requestSeen, "reply");
  EXPECT_EQ(_replyKeys,
            (std::vector<std::string>{"list", "after", "do", "caller", "operation", "pid"}));
  EXPECT_EQ(_reply["operation"], APP_CONTROL_OPERATION_SHARE);
  EXPECT_EQ(_reply["after"], "x");
  EXPECT_EQ(_reply["caller"], "none");
}

TEST_F(ALaunch, GoesToTheApplicationThatRuns) {
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  const std::string pid = _reply["pid"];
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_reply["pid"], pid);
  EXPECT_EQ(readFile(starts()), "start\n");
}

TEST_F(ALaunch, WithoutAnOperationIsTheDefaultOne) {
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_reply["operation"], APP_CONTROL_OPERATION_DEFAULT);
  char* operation = nullptr;
  app_control_get_operation(_request, &operation);
  EXPECT_EQ(operation, nullptr);
}

TEST_F(ALaunch, CanBeCanceledByTheApplication) {
  ASSERT_EQ(send("cancel"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_result, APP_CONTROL_RESULT_CANCELED);
}

TEST_F(ALaunch, FailsWhenTheApplicationDiesWithoutAReply) {
  ASSERT_EQ(send("die"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_result, APP_CONTROL_RESULT_FAILED);
  EXPECT_TRUE(_replyKeys.empty());
}

TEST_F(ALaunch, FailsWhenTheApplicationCannotBeStarted) {
  TestPhone::install("test.broken", "/nonexistent/program");
  app_control_set_app_id(_request, "test.broken");
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_result, APP_CONTROL_RESULT_FAILED);
}

TEST_F(ALaunch, NeedsNoBundleOfTheApplications) {
  bundlesFail = true;
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_result, APP_CONTROL_RESULT_SUCCEEDED);
  bundle* copy = nullptr;
  EXPECT_EQ(app_control_export_as_bundle(_request, &copy), APP_CONTROL_ERROR_OUT_OF_MEMORY);
  EXPECT_EQ(copy, nullptr);
}

TEST_F(ALaunch, FailsWithoutABundleOfTheApplications) {
  bundlesFail = true;
  TestPhone::install(kCallee, "/bin/false");
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_result, APP_CONTROL_RESULT_FAILED);
}

TEST_F(ALaunch, IsTriedAgainWhenTheApplicationWasJustQuitting) {
  TestPhone::install(kCallee, std::string(CALLEE) + " " + starts() + " --quitting");
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_result, APP_CONTROL_RESULT_SUCCEEDED);
  EXPECT_EQ(readFile(starts()), "start\nstart\n");
}

TEST_F(ALaunch, AnswersEveryOneOfManyAtOnce) {
  for (int i = 0; i < 20; i++) ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  EXPECT_TRUE(waitUntil([&] { return _replies == 20; }));
  EXPECT_EQ(readFile(starts()), "start\n");
}

TEST_F(ALaunch, TellsTheCalleeWhichApplicationCalls) {
  ReceivedRequests self;
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_reply["caller"], TestPhone::kAppId);
}

TEST_F(ALaunch, CanBeDoneInAnotherApplicationsName) {
  appfw::CallerName name("test.history");
  ASSERT_TRUE(name.isValid());
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_reply["caller"], "test.history");
}

TEST_F(ALaunch, WithoutACallbackAsksForNoReply) {
  ReceivedRequests self;
  self.start();
  app_control_set_app_id(_request, TestPhone::kAppId);
  ASSERT_EQ(app_control_send_launch_request(_request, nullptr, nullptr), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(self.waitFor(1));
  bool requested = true;
  app_control_is_reply_requested(self[0], &requested);
  EXPECT_FALSE(requested);
  EXPECT_EQ(app_control_reply_to_launch_request(_request, self[0], APP_CONTROL_RESULT_SUCCEEDED),
            APP_CONTROL_ERROR_INVALID_PARAMETER);
}

TEST_F(ALaunch, MayBeAnsweredThroughACloneOfTheRequest) {
  ReceivedRequests self;
  self.start();
  app_control_set_app_id(_request, TestPhone::kAppId);
  ASSERT_EQ(send("later"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(self.waitFor(1));
  EXPECT_EQ(_replies, 0);
  EXPECT_EQ(app_control_reply_to_launch_request(_request, self[0], APP_CONTROL_RESULT_SUCCEEDED),
            APP_CONTROL_ERROR_NONE);
  EXPECT_TRUE(waitForReply());
  EXPECT_EQ(_result, APP_CONTROL_RESULT_SUCCEEDED);
}

TEST_F(ALaunch, CanOnlyBeAnsweredByTheApplicationThatGotIt) {
  ReceivedRequests self;
  self.start();
  app_control_set_app_id(_request, TestPhone::kAppId);
  ASSERT_EQ(send("later"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(self.waitFor(1));

  common::OwnedBus own = base::sessionBus(), stranger = otherConnection();
  bool refused = false;
  for (int i = 1; i < 200 && !refused; i++) {
    // Reply objects are numbered; a stranger can guess them all.
    struct Answer {
      bool done = false, denied = false;
    } answer;
    g_dbus_connection_call(
        stranger.get(), g_dbus_connection_get_unique_name(own.get()),
        ("/phone/AppReply/" + std::to_string(i)).c_str(), "phone.AppReply1", "Reply",
        g_variant_new_parsed("(0, @a{sv} {'errorMessage': <'forged'>})"), nullptr,
        G_DBUS_CALL_FLAGS_NONE, -1, nullptr,
        [](GObject* bus, GAsyncResult* result, void* data) {
          common::OwnedError error;
          common::OwnedVariant value(
              g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, common::Out(error)));
          *static_cast<Answer*>(data) = {
              true, g_error_matches(error.get(), G_DBUS_ERROR, G_DBUS_ERROR_ACCESS_DENIED) != 0};
        },
        &answer);
    ASSERT_TRUE(waitUntil([&] { return answer.done; }));
    refused = answer.denied;
  }
  EXPECT_TRUE(refused);
  EXPECT_EQ(_replies, 0);
  app_control_reply_to_launch_request(_request, self[0], APP_CONTROL_RESULT_SUCCEEDED);
  EXPECT_TRUE(waitForReply());
  EXPECT_TRUE(_reply.count("errorMessage") == 0);
}

TEST_F(ALaunch, CarriesTextThatIsNotUtf8AsReplacementCharacters) {
  app_control_add_extra_data(_request, "name", "caf\xe9.jpg");
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_reply["name"], "caf\xef\xbf\xbd.jpg");
}

TEST_F(ALaunch, OfMoreThanAMebibyteIsRejected) {
  app_control_add_extra_data(_request, "k", std::string(1100000, 'x').c_str());
  EXPECT_EQ(send("reply"), APP_CONTROL_ERROR_LAUNCH_REJECTED);
}

TEST_F(ALaunch, OfAFileGoesToTheResolverWhenThereIsOne) {
  app_control_set_app_id(_request, nullptr);
  app_control_set_operation(_request, APP_CONTROL_OPERATION_VIEW);
  EXPECT_EQ(send("reply"), APP_CONTROL_ERROR_APP_NOT_FOUND);
  app_control_set_uri(_request, "/opt/usr/media/Downloads/a.jpg");
  EXPECT_EQ(send("reply"), APP_CONTROL_ERROR_APP_NOT_FOUND);
  TestPhone::install("com.orlant.resolver", CALLEE);
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  ASSERT_TRUE(waitForReply());
  EXPECT_EQ(_reply["operation"], APP_CONTROL_OPERATION_VIEW);
  ASSERT_EQ(send("quit"), APP_CONTROL_ERROR_NONE);
  EXPECT_TRUE(waitForReply());
}

TEST_F(ALaunch, OfAFileThatNoProgramOpensFindsNobody) {
  TestPhone::install("com.orlant.resolver", CALLEE);
  app_control_set_app_id(_request, nullptr);
  app_control_set_operation(_request, APP_CONTROL_OPERATION_VIEW);
  app_control_set_uri(_request, "nothing-opens-this");
  EXPECT_EQ(send("reply"), APP_CONTROL_ERROR_APP_NOT_FOUND);
}

TEST_F(ALaunch, IsRecordedAsOneJsonObjectPerLine) {
  const char* list[] = {"a\"b", "c\nd"};
  app_control_set_operation(_request, APP_CONTROL_OPERATION_SHARE);
  app_control_set_uri(_request, "file:///x");
  app_control_set_launch_mode(_request, APP_CONTROL_LAUNCH_MODE_SINGLE);
  app_control_add_extra_data(_request, "z", "first");
  app_control_add_extra_data_array(_request, "a", list, 2);
  std::remove((TestPhone::root() + "/dbspace/launches.jsonl").c_str());
  ASSERT_EQ(send("reply"), APP_CONTROL_ERROR_NONE);
  EXPECT_EQ(record(),
            "{\"caller\":\"test.self\",\"app_id\":\"test.callee\","
            "\"operation\":\"http://tizen.org/appcontrol/operation/share\",\"uri\":\"file:///x\","
            "\"mime\":null,\"launch_mode\":\"single\","
            "\"extras\":[[\"z\",\"first\"],[\"a\",[\"a\\\"b\",\"c\\nd\"]],[\"do\",\"reply\"]]}\n");
  EXPECT_TRUE(waitForReply());
}

TEST_F(ALaunch, SaysWhenItIsDelivered) {
  int delivered = -1;
  bundle* contents = bundle_create();
  bundle_add_str(contents, "do", "nothing");
  appfw::LaunchEvents events;
  events.onDelivered = [&](bool whole) { delivered = whole; };
  ASSERT_EQ(appfw::launch(kCallee, *contents, events), APP_CONTROL_ERROR_NONE);
  EXPECT_TRUE(waitUntil([&] { return delivered >= 0; }));
  EXPECT_EQ(delivered, 1);
  bundle_free(contents);
}

namespace {

/// A request that this program has received, as a bundle.
class AForward : public ALaunch {
 protected:
  AForward() {
    _self.start();
    app_control_set_app_id(_request, TestPhone::kAppId);
    app_control_add_extra_data(_request, "do", "nothing");
    app_control_add_extra_data(_request, "contents_token", "t");
    app_control_send_launch_request(_request, nullptr, nullptr);
    EXPECT_TRUE(_self.waitFor(1));
    app_control_h clone = nullptr;
    app_control_clone(&clone, _self[0]);
    app_control_set_app_id(clone, kCallee);
    app_control_export_as_bundle(clone, &_bundle);
    app_control_destroy(clone);
  }
  ~AForward() override { bundle_free(_bundle); }

  ReceivedRequests _self;
  bundle* _bundle = nullptr;
};

}  // namespace

TEST_F(AForward, SucceedsWithTheBundleOfAReceivedRequest) {
  EXPECT_GE(aul_forward_app(kCallee, _bundle), 0);
  EXPECT_TRUE(waitUntil([] { return readFile(starts()) == "start\n"; }));
}

TEST_F(AForward, NotesTheOriginalCallerInTheBundle) {
  aul_forward_app(kCallee, _bundle);
  EXPECT_EQ(std::string(bundle_get_val(_bundle, AUL_K_ORG_CALLER_PID)), std::to_string(getpid()));
  EXPECT_EQ(bundle_add_str(_bundle, "__APP_SVC_START_INFO__", kCallee), BUNDLE_ERROR_NONE);
  EXPECT_TRUE(waitUntil([] { return readFile(starts()) == "start\n"; }));
}

TEST_F(AForward, FailsWithoutACallerInTheBundle) {
  bundle_del(_bundle, AUL_K_CALLER_PID);
  EXPECT_EQ(aul_forward_app(kCallee, _bundle), AUL_R_EINVAL);
  EXPECT_EQ(aul_forward_app(kCallee, nullptr), AUL_R_EINVAL);
  EXPECT_EQ(aul_forward_app(nullptr, _bundle), AUL_R_EINVAL);
}

TEST_F(AForward, FailsWhenTheApplicationIsNotThere) {
  EXPECT_EQ(aul_forward_app("test.nobody", _bundle), AUL_R_ENOAPP);
}

TEST_F(AForward, ArrivesWithTheForwarderAsCaller) {
  bundle_add_str(_bundle, "marker", "forwarded");
  ASSERT_GE(aul_forward_app(TestPhone::kAppId, _bundle), 0);
  ASSERT_TRUE(_self.waitFor(2));
  EXPECT_EQ(ReceivedRequests::caller(_self[1]), TestPhone::kAppId);
  EXPECT_EQ(ReceivedRequests::extra(_self[1], "marker"), "forwarded");
  EXPECT_EQ(ReceivedRequests::extra(_self[1], "contents_token"), "t");
}
