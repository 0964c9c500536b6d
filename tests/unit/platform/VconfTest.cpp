#include "TestPhone.h"

#include <vconf.h>

#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace {

struct Heard {
  std::vector<std::string> keys;
  std::string order;
};

void firstCb(keynode_t* node, void* data) {
  auto* heard = static_cast<Heard*>(data);
  heard->keys.push_back(vconf_keynode_get_name(node));
  heard->order += "1";
}

void secondCb(keynode_t*, void* data) {
  static_cast<Heard*>(data)->order += "2";
}

void removingCb(keynode_t*, void* data) {
  static_cast<Heard*>(data)->order += "0";
  vconf_ignore_key_changed("test/key", firstCb);
}

/// Sets the key in another process, with a bus connection of its own.
void setElsewhere(const char* key, const char* value) {
  const char* const command[] = {SET_VCONF, key, value, nullptr};
  int status = -1;
  ASSERT_TRUE(g_spawn_sync(nullptr, const_cast<char**>(command), nullptr, G_SPAWN_DEFAULT, nullptr,
                           nullptr, nullptr, nullptr, &status, nullptr));
  ASSERT_EQ(status, 0);
}

class Vconf : public testing::Test {
 protected:
  ~Vconf() override {
    for (const auto callback : {firstCb, secondCb, removingCb}) {
      vconf_ignore_key_changed("test/key", callback);
    }
  }
  Heard _heard;
};

}  // namespace

TEST_F(Vconf, KeepsTextsNumbersAndTruthValues) {
  int number = 0, truth = 7;
  EXPECT_EQ(vconf_set_str("test/text", "value"), VCONF_OK);
  EXPECT_EQ(vconf_set_int("test/number", -5), VCONF_OK);
  EXPECT_EQ(vconf_set_bool("test/truth", 9), VCONF_OK);
  EXPECT_EQ(take(vconf_get_str("test/text")), "value");
  EXPECT_EQ(vconf_get_int("test/number", &number), VCONF_OK);
  EXPECT_EQ(number, -5);
  EXPECT_EQ(vconf_get_bool("test/truth", &truth), VCONF_OK);
  EXPECT_EQ(truth, 1);
}

TEST_F(Vconf, HasNothingUnderUnsetKeysAndOtherTypes) {
  int number = 3;
  vconf_set_str("test/text", "7");
  vconf_set_int("test/number", 7);
  EXPECT_EQ(vconf_get_str("test/unset"), nullptr);
  EXPECT_EQ(vconf_get_str("test/number"), nullptr);
  EXPECT_EQ(vconf_get_int("test/text", &number), VCONF_ERROR);
  EXPECT_EQ(vconf_get_int("test/unset", &number), VCONF_ERROR);
  EXPECT_EQ(number, 3);
}

TEST_F(Vconf, RefusesMissingKeysAndOversizeTexts) {
  EXPECT_EQ(vconf_set_str(nullptr, "v"), VCONF_ERROR);
  EXPECT_EQ(vconf_set_str("", "v"), VCONF_ERROR);
  EXPECT_EQ(vconf_set_str("k", nullptr), VCONF_ERROR);
  EXPECT_EQ(vconf_set_str("k", std::string(4097, 'x').c_str()), VCONF_ERROR);
  EXPECT_EQ(vconf_set_str("k", std::string(4096, 'x').c_str()), VCONF_OK);
  EXPECT_EQ(vconf_get_str(nullptr), nullptr);
  EXPECT_EQ(vconf_notify_key_changed("k", nullptr, nullptr), VCONF_ERROR);
}

TEST_F(Vconf, TellsOfAChangeInAnotherProcess) {
  vconf_notify_key_changed("test/key", firstCb, &_heard);
  setElsewhere("test/other", "x");
  setElsewhere("test/key", "from elsewhere");
  ASSERT_TRUE(waitUntil([&] { return !_heard.keys.empty(); }));
  EXPECT_EQ(_heard.keys, std::vector<std::string>{"test/key"});
  EXPECT_EQ(take(vconf_get_str("test/key")), "from elsewhere");
}

TEST_F(Vconf, CallsInTheOrderOfRegistration) {
  vconf_notify_key_changed("test/key", secondCb, &_heard);
  vconf_notify_key_changed("test/key", firstCb, &_heard);
  vconf_set_str("test/key", "order");
  ASSERT_TRUE(waitUntil([&] { return _heard.order.size() == 2; }));
  EXPECT_EQ(_heard.order, "21");
}

TEST_F(Vconf, CallsNobodyWhoHasLeft) {
  vconf_notify_key_changed("test/key", firstCb, &_heard);
  vconf_notify_key_changed("test/key", secondCb, &_heard);
  EXPECT_EQ(vconf_ignore_key_changed("test/key", firstCb), VCONF_OK);
  EXPECT_EQ(vconf_ignore_key_changed("test/key", firstCb), VCONF_ERROR);
  vconf_set_str("test/key", "left");
  ASSERT_TRUE(waitUntil([&] { return !_heard.order.empty(); }));
  EXPECT_EQ(_heard.order, "2");
}

TEST_F(Vconf, SparesAListenerThatAnotherOneRemoved) {
  vconf_notify_key_changed("test/key", removingCb, &_heard);
  vconf_notify_key_changed("test/key", firstCb, &_heard);
  vconf_notify_key_changed("test/key", secondCb, &_heard);
  vconf_set_str("test/key", "removed");
  ASSERT_TRUE(waitUntil([&] { return _heard.order.size() >= 2; }));
  EXPECT_EQ(_heard.order, "02");
}

TEST_F(Vconf, KeepsQuietWhenNothingChanges) {
  vconf_set_str("test/key", "same");
  settle();
  vconf_notify_key_changed("test/key", firstCb, &_heard);
  vconf_set_str("test/key", "same");
  settle();
  EXPECT_TRUE(_heard.keys.empty());
}

TEST_F(Vconf, IgnoresSignalsOfAnotherShape) {
  vconf_notify_key_changed("test/key", firstCb, &_heard);
  common::OwnedBus other = otherConnection();
  g_dbus_connection_emit_signal(other.get(), nullptr, "/phone/Vconf", "phone.Vconf1", "Changed",
                                g_variant_new("(i)", 7), nullptr);
  g_dbus_connection_flush_sync(other.get(), nullptr, nullptr);
  settle();
  EXPECT_TRUE(_heard.keys.empty());
}
