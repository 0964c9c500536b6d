// The world around the phone: what it answers on the buses, and how commands change it.

#include <gtest/gtest.h>

#include "Phone.h"

using phone::Phone;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

std::string property(const std::string& name, const std::string& path, const std::string& interface,
                     const std::string& property) {
  return thePhone()({"shell", "gdbus", "call", "--system", "--dest", name, "--object-path", path,
                     "--method", "org.freedesktop.DBus.Properties.Get", interface, property});
}

std::string network(const std::string& what) {
  return property("org.freedesktop.NetworkManager", "/org/freedesktop/NetworkManager",
                  "org.freedesktop.NetworkManager", what);
}

}  // namespace

TEST(PhoneNetwork, IsWhatNetworkManagerSays) {
  const std::pair<const char*, const char*> kinds[] = {{"cellular", "(<'gsm'>,)\n"},
                                                       {"ethernet", "(<'802-3-ethernet'>,)\n"},
                                                       {"none", "(<''>,)\n"},
                                                       {"wifi", "(<'802-11-wireless'>,)\n"}};
  for (const auto& [kind, type] : kinds) {
    thePhone()({"network", kind});
    EXPECT_EQ(network("PrimaryConnectionType"), type);
    EXPECT_EQ(network("State"),
              kind == std::string("none") ? "(<uint32 20>,)\n" : "(<uint32 70>,)\n");
  }
}

TEST(PhoneRotation, IsWhatTheOrientationSensorSays) {
  const std::pair<const char*, const char*> turns[] = {{"90", "(<'left-up'>,)\n"},
                                                       {"180", "(<'bottom-up'>,)\n"},
                                                       {"270", "(<'right-up'>,)\n"},
                                                       {"0", "(<'normal'>,)\n"}};
  for (const auto& [turn, orientation] : turns) {
    thePhone()({"rotate", turn});
    EXPECT_EQ(property("net.hadess.SensorProxy", "/net/hadess/SensorProxy",
                       "net.hadess.SensorProxy", "AccelerometerOrientation"),
              orientation);
  }
}

TEST(PhoneBattery, IsWhatThePowerServiceSays) {
  thePhone()({"battery", "37"});
  EXPECT_EQ(property("org.freedesktop.UPower", "/org/freedesktop/UPower/devices/DisplayDevice",
                     "org.freedesktop.UPower.Device", "Percentage"),
            "(<37.0>,)\n");
  EXPECT_EQ(thePhone().command({"battery", "101"}).status, 2);
}

TEST(PhoneModem, HasACardWithThePhonesNumber) {
  EXPECT_EQ(property("org.freedesktop.ModemManager1", "/org/freedesktop/ModemManager1/SIM/0",
                     "org.freedesktop.ModemManager1.Sim", "Imsi"),
            "(<'001011012345678'>,)\n");
}

TEST(PhoneSignal, IsSeenOnTheSystemBus) {
  Phone& phone = thePhone();
  phone({"signal", "file_downloading", "http://here/\"1\""});
  EXPECT_TRUE(waitFor([&] {
    for (const auto& line : phone.lines("signals")) {
      if (line.find("\"file_downloading\"") != std::string::npos &&
          line.find("/com/orlant/remoteshare") != std::string::npos &&
          line.find("org.tizen.call.remote.share") != std::string::npos &&
          line.find("http://here/\\\"1\\\"") != std::string::npos) {
        return true;
      }
    }
    return false;
  }));
}

TEST(PhonePrefs, AreSetReadListedAndRemoved) {
  Phone& phone = thePhone();
  phone({"prefs", "set", "http://a/b?c=d", "/opt/usr/media/file"});
  EXPECT_EQ(phone({"prefs", "get", "http://a/b?c=d"}), "/opt/usr/media/file\n");
  EXPECT_EQ(phone({"prefs", "list"}), "http://a/b?c=d=/opt/usr/media/file\n");
  phone({"prefs", "remove", "http://a/b?c=d"});
  EXPECT_EQ(phone.command({"prefs", "get", "http://a/b?c=d"}).status, 1);
  EXPECT_EQ(phone({"prefs", "list"}), "");
}

TEST(PhoneContacts, AreAddedRenamedAndRemoved) {
  Phone& phone = thePhone();
  phone({"contact", "add", "Mina Park", "+821055556666"});
  EXPECT_EQ(phone({"contact", "list"}), "Mina Park\t+821055556666\n");
  phone({"contact", "rename", "Mina Park", "M. Park"});
  EXPECT_EQ(phone({"contact", "list"}), "M. Park\t+821055556666\n");
  EXPECT_EQ(phone.command({"contact", "remove", "Mina Park"}).status, 1);
  phone({"contact", "remove", "M. Park"});
  EXPECT_EQ(phone({"contact", "list"}), "");
}

TEST(PhoneMessages, AreWhatTheStatusBarShowed) {
  Phone& phone = thePhone();
  phone({"shell", "gdbus", "call", "--session", "--dest", "org.freedesktop.Notifications",
         "--object-path", "/org/freedesktop/Notifications", "--method",
         "org.freedesktop.Notifications.Notify", "test", "0", "", "", "Rock &amp; roll", "[]", "{}",
         "3000"});
  EXPECT_TRUE(waitFor([&] { return phone({"messages"}) == "Rock & roll\n"; }));
}

TEST(PhoneLanguage, IsThatOfEverythingThatStartsLater) {
  Phone& phone = thePhone();
  phone({"language", "de_DE"});
  EXPECT_EQ(phone({"shell", "sh", "-c", "echo $LANG"}), "de_DE.UTF-8\n");
  phone({"language", "en_US.UTF-8"});
  EXPECT_EQ(phone({"shell", "sh", "-c", "echo $LANG"}), "en_US.UTF-8\n");
}

TEST(PhoneLook, IsWhatTheApplicationsFollow) {
  const auto setting = [](const char* key) {
    return thePhone()({"shell", PHONE_VCONF, "get", key});
  };
  thePhone()({"theme", "dark"});
  EXPECT_EQ(setting("db/setting/theme"), "dark\n");
  thePhone()({"theme", "light"});
  EXPECT_EQ(setting("db/setting/theme"), "light\n");
  thePhone()({"textsize", "150"});
  EXPECT_EQ(setting("db/setting/accessibility/font_size"), "150\n");
  thePhone()({"textsize", "100"});
}

TEST(PhoneService, KeepsItsAddressThroughItsFaults) {
  Phone& phone = thePhone();
  const auto address = [&] {
    const std::string status = phone({"status"});
    const size_t begin = status.find("service: http");
    return status.substr(begin, status.find('\n', begin) - begin);
  };
  const std::string before = address();
  ASSERT_NE(before.find("http://127.0.0.1:"), std::string::npos);
  for (const Words& fault : {Words{"service", "down"},
                             {"service", "slow", "200"},
                             {"service", "refuse"},
                             {"service", "down"},
                             {"service", "ok"}}) {
    phone(fault);
    EXPECT_EQ(address(), before);
  }
  const phone::Share share = phone.share({phone.makeFile("after.txt")});
  EXPECT_FALSE(share.token.empty());
}

TEST(PhoneShare, TakesFilesThatLieWhereThePhoneHasItsOwnFolders) {
  Phone& phone = thePhone();
  char name[] = "/tmp/phone-share-XXXXXX";
  ASSERT_NE(mkdtemp(name), nullptr);
  const std::string file = std::string(name) + "/a file.txt";
  phone::run({"sh", "-c", "echo text >\"$1\"", "sh", file});
  EXPECT_FALSE(phone.share({file}).token.empty());
  phone::run({"rm", "-r", name});
}
