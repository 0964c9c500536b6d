#include "TestPhone.h"

#include <app_control_internal.h>
#include <appfw/BusNames.h>
#include <aul.h>
#include <ui-gadget.h>

#include <cstdlib>
#include <vector>

namespace {

class AppControl : public testing::Test {
 protected:
  AppControl() { app_control_create(&_request); }
  ~AppControl() override { app_control_destroy(_request); }

  std::string extra(app_control_h request, const char* key) {
    char* value = nullptr;
    app_control_get_extra_data(request, key, &value);
    return take(value);
  }

  std::vector<std::string> extraKeys(app_control_h request) {
    std::vector<std::string> keys;
    app_control_foreach_extra_data(
        request,
        [](app_control_h, const char* key, void* data) {
          static_cast<std::vector<std::string>*>(data)->push_back(key);
          return true;
        },
        &keys);
    return keys;
  }

  app_control_h _request = nullptr;
};

}  // namespace

TEST_F(AppControl, AnswersNullForWhatIsNotSet) {
  char* text = const_cast<char*>("untouched");
  EXPECT_EQ(app_control_get_operation(_request, &text), APP_CONTROL_ERROR_NONE);
  EXPECT_EQ(text, nullptr);
  app_control_launch_mode_e mode = APP_CONTROL_LAUNCH_MODE_GROUP;
  EXPECT_EQ(app_control_get_launch_mode(_request, &mode), APP_CONTROL_ERROR_NONE);
  EXPECT_EQ(mode, APP_CONTROL_LAUNCH_MODE_SINGLE);
}

TEST_F(AppControl, ClearsWithNull) {
  char* text = nullptr;
  app_control_set_uri(_request, "file:///a");
  app_control_set_uri(_request, nullptr);
  app_control_get_uri(_request, &text);
  EXPECT_EQ(text, nullptr);
}

TEST_F(AppControl, RefusesEmptyKeysAndValues) {
  const char* none = nullptr;
  EXPECT_EQ(app_control_add_extra_data(_request, "k", ""), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_add_extra_data(_request, "", "v"), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_add_extra_data(_request, none, "v"), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_add_extra_data(_request, "k", none), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_add_extra_data(nullptr, "k", "v"), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_TRUE(extraKeys(_request).empty());
}

TEST_F(AppControl, KeepsWhatItHasWhenAValueIsRefused) {
  app_control_add_extra_data(_request, "k", "v");
  app_control_add_extra_data(_request, "k", "");
  EXPECT_EQ(extra(_request, "k"), "v");
}

TEST_F(AppControl, RejectsTheSystemsOwnKeys) {
  const char* list[] = {"x"};
  for (const char* key : {AUL_K_CALLER_PID, AUL_K_CALLER_APPID, "__APP_SVC_OP_TYPE__"}) {
    EXPECT_EQ(app_control_add_extra_data(_request, key, "v"), APP_CONTROL_ERROR_KEY_REJECTED);
    EXPECT_EQ(app_control_add_extra_data_array(_request, key, list, 1),
              APP_CONTROL_ERROR_KEY_REJECTED);
  }
}

TEST_F(AppControl, ReplacesAnExtraWhateverItsKind) {
  const char* list[] = {"x", "y"};
  app_control_add_extra_data(_request, "k", "first");
  app_control_add_extra_data(_request, "k", "second");
  EXPECT_EQ(extra(_request, "k"), "second");
  app_control_add_extra_data_array(_request, "k", list, 2);
  bool array = false;
  EXPECT_EQ(app_control_is_extra_data_array(_request, "k", &array), APP_CONTROL_ERROR_NONE);
  EXPECT_TRUE(array);
}

TEST_F(AppControl, ListsExtrasInTheOrderOfAddition) {
  const char* list[] = {"x"};
  app_control_set_operation(_request, APP_CONTROL_OPERATION_VIEW);
  app_control_add_extra_data(_request, "url", "1");
  app_control_add_extra_data_array(_request, "name", list, 1);
  app_control_add_extra_data(_request, "all", "3");
  EXPECT_EQ(extraKeys(_request), (std::vector<std::string>{"url", "name", "all"}));
}

TEST_F(AppControl, GivesAnArrayAsBlocksOfItsOwn) {
  const char* list[] = {"one", "two"};
  app_control_add_extra_data_array(_request, "k", list, 2);
  char** texts = nullptr;
  int length = 0;
  ASSERT_EQ(app_control_get_extra_data_array(_request, "k", &texts, &length),
            APP_CONTROL_ERROR_NONE);
  app_control_remove_extra_data(_request, "k");
  ASSERT_EQ(length, 2);
  EXPECT_EQ(take(texts[0]), "one");
  EXPECT_EQ(take(texts[1]), "two");
  free(texts);
}

TEST_F(AppControl, DoesNotTakeAnArrayForATextNorTheReverse) {
  const char* list[] = {"one"};
  char* text = nullptr;
  char** texts = nullptr;
  int length = 9;
  app_control_add_extra_data_array(_request, "list", list, 1);
  app_control_add_extra_data(_request, "text", "v");
  EXPECT_EQ(app_control_get_extra_data(_request, "list", &text),
            APP_CONTROL_ERROR_INVALID_DATA_TYPE);
  EXPECT_EQ(app_control_get_extra_data_array(_request, "text", &texts, &length),
            APP_CONTROL_ERROR_INVALID_DATA_TYPE);
  EXPECT_EQ(text, nullptr);
  EXPECT_EQ(texts, nullptr);
  EXPECT_EQ(length, 0);
}

TEST_F(AppControl, SaysWhenAnExtraIsMissing) {
  char* text = nullptr;
  char** texts = nullptr;
  int length = 0;
  EXPECT_EQ(app_control_get_extra_data(_request, "k", &text), APP_CONTROL_ERROR_KEY_NOT_FOUND);
  EXPECT_EQ(app_control_get_extra_data_array(_request, "k", &texts, &length),
            APP_CONTROL_ERROR_KEY_NOT_FOUND);
  EXPECT_EQ(app_control_remove_extra_data(_request, "k"), APP_CONTROL_ERROR_KEY_NOT_FOUND);
}

TEST_F(AppControl, ClonesIntoItsFirstArgument) {
  app_control_set_operation(_request, APP_CONTROL_OPERATION_SHARE);
  app_control_add_extra_data(_request, "k", "v");
  app_control_h clone = nullptr;
  ASSERT_EQ(app_control_clone(&clone, _request), APP_CONTROL_ERROR_NONE);
  app_control_add_extra_data(_request, "k", "changed");
  char* operation = nullptr;
  app_control_get_operation(clone, &operation);
  EXPECT_EQ(take(operation), APP_CONTROL_OPERATION_SHARE);
  EXPECT_EQ(extra(clone, "k"), "v");
  app_control_destroy(clone);
}

TEST_F(AppControl, IsNotClonedFromNothing) {
  app_control_h clone = nullptr;
  EXPECT_EQ(app_control_clone(&clone, nullptr), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(clone, nullptr);
}

TEST_F(AppControl, HasNoCallerUnlessItWasReceived) {
  char* caller = nullptr;
  bool requested = true;
  EXPECT_EQ(app_control_get_caller(_request, &caller), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_is_reply_requested(_request, &requested),
            APP_CONTROL_ERROR_INVALID_PARAMETER);
}

TEST_F(AppControl, TellsTheCallerOfAReceivedRequestAndOfItsClone) {
  bundle* data = bundle_create();
  bundle_add_str(data, AUL_K_CALLER_APPID, "test.sender");
  app_control_h received = nullptr, clone = nullptr;
  app_control_create_event(data, &received);
  app_control_clone(&clone, received);
  char* caller = nullptr;
  EXPECT_EQ(app_control_get_caller(clone, &caller), APP_CONTROL_ERROR_NONE);
  EXPECT_EQ(take(caller), "test.sender");
  app_control_destroy(clone);
  app_control_destroy(received);
  bundle_free(data);
}

TEST_F(AppControl, TravelsThroughABundleUnderTheKnownKeys) {
  app_control_set_operation(_request, "op");
  app_control_set_uri(_request, "uri");
  app_control_set_mime(_request, "mime");
  app_control_set_app_id(_request, "id");
  app_control_set_launch_mode(_request, APP_CONTROL_LAUNCH_MODE_GROUP);
  app_control_add_extra_data(_request, "k", "v");
  bundle* exported = nullptr;
  ASSERT_EQ(app_control_export_as_bundle(_request, &exported), APP_CONTROL_ERROR_NONE);
  EXPECT_STREQ(bundle_get_val(exported, "__APP_SVC_OP_TYPE__"), "op");
  EXPECT_STREQ(bundle_get_val(exported, "__APP_SVC_URI__"), "uri");
  EXPECT_STREQ(bundle_get_val(exported, "__APP_SVC_MIME_TYPE__"), "mime");
  EXPECT_STREQ(bundle_get_val(exported, "__APP_SVC_PKG_NAME__"), "id");
  EXPECT_STREQ(bundle_get_val(exported, "k"), "v");

  app_control_h other = nullptr;
  app_control_create(&other);
  app_control_add_extra_data(other, "before", "gone");
  app_control_import_from_bundle(other, exported);
  app_control_launch_mode_e mode = APP_CONTROL_LAUNCH_MODE_SINGLE;
  app_control_get_launch_mode(other, &mode);
  EXPECT_EQ(mode, APP_CONTROL_LAUNCH_MODE_GROUP);
  EXPECT_EQ(extraKeys(other), std::vector<std::string>{"k"});
  app_control_destroy(other);
  bundle_free(exported);
}

TEST_F(AppControl, ToleratesNoHandle) {
  EXPECT_EQ(app_control_destroy(nullptr), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_set_operation(nullptr, "x"), APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_send_launch_request(nullptr, nullptr, nullptr),
            APP_CONTROL_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(app_control_set_launch_mode(_request, static_cast<app_control_launch_mode_e>(7)),
            APP_CONTROL_ERROR_INVALID_PARAMETER);
}

TEST(UiGadget, NeedsAWindowAndAKnownOption) {
  int window = 0;
  EXPECT_EQ(UG_INIT_EFL(&window, UG_OPT_INDICATOR_ENABLE), 0);
  EXPECT_EQ(UG_INIT_EFL(nullptr, UG_OPT_INDICATOR_ENABLE), -1);
  EXPECT_EQ(UG_INIT_EFL(&window, UG_OPT_MAX), -1);
}

TEST(BusNames, ComeBackAsTheApplicationIdsTheyWereMadeOf) {
  for (const char* id : {"com.orlant.zelqo", "contacts-tabui-efl", "a_b", "org.7zip", "x..y",
                         "dot.", "9lives", "caf\xc3\xa9", "a b"}) {
    const std::string name = appfw::busName(id);
    EXPECT_TRUE(g_dbus_is_name(name.c_str())) << id;
    EXPECT_EQ(appfw::appIdOfBusName(name), id);
  }
}

TEST(BusNames, AreThePlainIdWhereItIsPlain) {
  EXPECT_EQ(appfw::busName("com.orlant.zelqo"), "phoneapp.icom.orlant.zelqo");
  EXPECT_EQ(appfw::busName("contacts-tabui-efl"), "phoneapp.icontacts-tabui-efl");
}

TEST(BusNames, DoNotExistForImpossibleIds) {
  EXPECT_EQ(appfw::busName(""), "");
  EXPECT_EQ(appfw::busName(std::string(300, 'x')), "");
  EXPECT_EQ(appfw::appIdOfBusName("org.freedesktop.DBus"), "");
  EXPECT_EQ(appfw::appIdOfBusName("phoneapp.ia_"), "");
}
