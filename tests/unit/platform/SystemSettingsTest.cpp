#include "TestPhone.h"

#include <system_settings.h>
#include <vconf.h>

#include <cstdlib>
#include <ctime>
#include <vector>

namespace {

constexpr auto kLanguage = SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE;
constexpr auto k24Hour = SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR;
constexpr auto kTime = SYSTEM_SETTINGS_KEY_TIME_CHANGED;
constexpr auto kZone = SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE;

using Keys = std::vector<int>;

void heardCb(system_settings_key_e key, void* data) {
  static_cast<Keys*>(data)->push_back(key);
}

void earlierCb(keynode_t*, void* data) {
  static_cast<Keys*>(data)->push_back(0);
}

/// The time service, as far as the settings listen to it.
class FakeTimeService {
 public:
  FakeTimeService() {
    common::OwnedVariant answer(g_dbus_connection_call_sync(
        _bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
        "RequestName", g_variant_new("(su)", "org.freedesktop.timedate1", 0u), nullptr,
        G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
  }
  void announce(const char* zone) {
    emit(g_variant_new_parsed("('org.freedesktop.timedate1', @a{sv} {'Timezone': <%s>}, @as [])",
                              zone));
  }
  void emit(GVariant* arguments) {
    g_dbus_connection_emit_signal(_bus.get(), nullptr, "/org/freedesktop/timedate1",
                                  "org.freedesktop.DBus.Properties", "PropertiesChanged", arguments,
                                  nullptr);
    g_dbus_connection_flush_sync(_bus.get(), nullptr, nullptr);
  }

 private:
  common::OwnedBus _bus = otherConnection();
};

class SystemSettings : public testing::Test {
 protected:
  SystemSettings() { setenv("TZ", "UTC", 1); }
  ~SystemSettings() override {
    for (const auto key : {kLanguage, k24Hour, kTime, kZone}) system_settings_unset_changed_cb(key);
  }
  bool waitFor(const Keys& keys) {
    return waitUntil([&] { return _heard.size() >= keys.size(); }) && _heard == keys;
  }
  Keys _heard;
};

}  // namespace

TEST_F(SystemSettings, ReportALanguageChangeAsNumber13) {
  system_settings_set_changed_cb(kLanguage, heardCb, &_heard);
  vconf_set_str(VCONFKEY_LANGSET, "ko_KR.UTF-8");
  EXPECT_TRUE(waitFor({13}));
  char* language = nullptr;
  EXPECT_EQ(system_settings_get_value_string(kLanguage, &language), SYSTEM_SETTINGS_ERROR_NONE);
  EXPECT_EQ(take(language), "ko_KR.UTF-8");
}

TEST_F(SystemSettings, ReportThe24HourFormatAsNumber14) {
  vconf_set_int(VCONFKEY_REGIONFORMAT_TIME1224, VCONFKEY_TIME_FORMAT_12);
  settle();
  system_settings_set_changed_cb(k24Hour, heardCb, &_heard);
  EXPECT_EQ(system_settings_set_value_bool(k24Hour, true), SYSTEM_SETTINGS_ERROR_NONE);
  EXPECT_TRUE(waitFor({14}));
  bool is24Hour = false;
  system_settings_get_value_bool(k24Hour, &is24Hour);
  EXPECT_TRUE(is24Hour);
}

TEST_F(SystemSettings, ReportATimeZoneAsATimeChangeWithTheZoneInForce) {
  FakeTimeService service;
  system_settings_set_changed_cb(kTime, heardCb, &_heard);
  service.announce("Asia/Seoul");
  EXPECT_TRUE(waitFor({16}));
  const time_t epoch = 0;
  EXPECT_EQ(localtime(&epoch)->tm_hour, 9);
  char* zone = nullptr;
  system_settings_get_value_string(kZone, &zone);
  EXPECT_EQ(take(zone), "Asia/Seoul");
}

TEST_F(SystemSettings, ReportTheZoneBeforeTheTime) {
  FakeTimeService service;
  system_settings_set_changed_cb(kTime, heardCb, &_heard);
  system_settings_set_changed_cb(kZone, heardCb, &_heard);
  service.announce("Europe/Berlin");
  EXPECT_TRUE(waitFor({15, 16}));
}

TEST_F(SystemSettings, IgnoreZonesThatAreNone) {
  FakeTimeService service;
  system_settings_set_changed_cb(kTime, heardCb, &_heard);
  for (const char* zone : {"", "../../etc/passwd", ":/etc/passwd", "A B", "UTC"}) {
    service.announce(zone);
  }
  service.emit(g_variant_new("(i)", 7));
  service.announce("Asia/Tokyo");
  EXPECT_TRUE(waitFor({16}));
  EXPECT_STREQ(getenv("TZ"), "Asia/Tokyo");
}

TEST_F(SystemSettings, HaveOneCallbackPerKey) {
  Keys before;
  system_settings_set_changed_cb(kLanguage, heardCb, &before);
  system_settings_set_changed_cb(kLanguage, heardCb, &_heard);
  vconf_set_str(VCONFKEY_LANGSET, "de_DE.UTF-8");
  EXPECT_TRUE(waitFor({13}));
  EXPECT_TRUE(before.empty());
}

TEST_F(SystemSettings, CallNobodyAfterUnset) {
  system_settings_set_changed_cb(kLanguage, heardCb, &_heard);
  system_settings_unset_changed_cb(kLanguage);
  vconf_set_str(VCONFKEY_LANGSET, "fr_FR.UTF-8");
  settle();
  EXPECT_TRUE(_heard.empty());
}

TEST_F(SystemSettings, LetACallbackUnsetItself) {
  FakeTimeService service;
  system_settings_set_changed_cb(
      kTime,
      [](system_settings_key_e key, void* data) {
        heardCb(key, data);
        system_settings_unset_changed_cb(key);
      },
      &_heard);
  service.announce("Asia/Seoul");
  ASSERT_TRUE(waitFor({16}));
  service.announce("Europe/Berlin");
  settle();
  EXPECT_EQ(_heard, (Keys{16}));
}

TEST_F(SystemSettings, ComeBeforeNoVconfListenerThatWasThereFirst) {
  vconf_notify_key_changed(VCONFKEY_LANGSET, earlierCb, &_heard);
  system_settings_set_changed_cb(kLanguage, heardCb, &_heard);
  vconf_set_str(VCONFKEY_LANGSET, "es_ES.UTF-8");
  EXPECT_TRUE(waitFor({0, 13}));
  vconf_ignore_key_changed(VCONFKEY_LANGSET, earlierCb);
}

TEST_F(SystemSettings, RefuseWhatTheyDoNotHave) {
  char* text = nullptr;
  bool truth = false;
  EXPECT_EQ(system_settings_set_changed_cb(kLanguage, nullptr, nullptr),
            SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(system_settings_set_changed_cb(SYSTEM_SETTINGS_KEY_FONT_TYPE, heardCb, &_heard),
            SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED);
  EXPECT_EQ(system_settings_get_value_string(k24Hour, &text), SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED);
  EXPECT_EQ(system_settings_get_value_bool(kLanguage, &truth), SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED);
  EXPECT_EQ(system_settings_get_value_string(kLanguage, nullptr),
            SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER);
}
