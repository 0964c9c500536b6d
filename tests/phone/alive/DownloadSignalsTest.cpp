// What the download application tells on the system bus, on the cells and the button of the page.

#include <gio/gio.h>

#include <memory>

#include "AlivePage.h"

using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr const char* kPath = "/com/orlant/remoteshare";
constexpr const char* kInterface = "org.tizen.call.remote.share";

class DownloadSignals : public AlivePage {
 protected:
  void SetUp() override {
    _share = thePhone().share({thePhone().makeFile("One.txt"), thePhone().makeFile("Two.txt")});
    thePhone().launchReceived(_share.token);
    ASSERT_TRUE(cellIs("One.txt", "not downloaded"));
    ASSERT_TRUE(downloadIsEnabled(true));
  }

  std::string url(int file) const { return addressOf(_share, "file", file); }
  void tell(const char* member, int file) const { thePhone()({"signal", member, url(file)}); }
  void expectAlive() const {
    tell("file_downloaded", 1);
    EXPECT_TRUE(cellIs("Two.txt", "downloaded"));
    EXPECT_TRUE(cellIs("One.txt", "not downloaded"));
    EXPECT_TRUE(downloadIsEnabled(true));
  }

 private:
  Share _share;
};

void emit(const char* member, const Words& arguments) {
  Words words = {"shell", "gdbus", "emit", "--system", "--object-path", kPath, "--signal"};
  words.push_back(std::string(kInterface) + "." + member);
  words.insert(words.end(), arguments.begin(), arguments.end());
  thePhone()(words);
}

// The phone's system bus, reached from outside.
class SystemBus {
 public:
  SystemBus() {
    const std::string address = "unix:path=" + thePhone().folder() + "/run/system.bus";
    const auto flags =
        static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                          G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION);
    GError* error = nullptr;
    _bus.reset(
        g_dbus_connection_new_for_address_sync(address.c_str(), flags, nullptr, nullptr, &error));
    EXPECT_TRUE(_bus) << error->message;
    g_clear_error(&error);
  }

  void tell(const char* member, const std::string& url) {
    g_dbus_connection_emit_signal(_bus.get(), nullptr, kPath, kInterface, member,
                                  g_variant_new("(s)", url.c_str()), nullptr);
  }
  bool flush() { return g_dbus_connection_flush_sync(_bus.get(), nullptr, nullptr); }

 private:
  struct Unref {
    void operator()(GDBusConnection* bus) const { g_object_unref(bus); }
  };
  std::unique_ptr<GDBusConnection, Unref> _bus;
};

}  // namespace

TEST_F(DownloadSignals, ChangeTheStateOfTheirCellOnly) {
  tell("file_downloading", 0);
  EXPECT_TRUE(cellIs("One.txt", "downloading"));
  EXPECT_TRUE(cellIs("Two.txt", "not downloaded"));
  EXPECT_TRUE(downloadIsEnabled(true));
  tell("file_downloaded", 0);
  EXPECT_TRUE(cellIs("One.txt", "downloaded"));
}

TEST_F(DownloadSignals, DisableDownloadWhileEveryFileIsOnItsWay) {
  tell("file_downloading", 0);
  tell("file_downloading", 1);
  EXPECT_TRUE(downloadIsEnabled(false));
  tell("file_downloaded", 1);
  EXPECT_TRUE(downloadIsEnabled(true));
  EXPECT_TRUE(cellIs("One.txt", "downloading"));
  EXPECT_TRUE(cellIs("Two.txt", "downloaded"));
}

TEST_F(DownloadSignals, ReachThePageBelowTheFullPage) {
  thePhone()({"tap", "One.txt"});
  ASSERT_TRUE(goes("Files from"));
  tell("file_downloading", 0);
  tell("file_downloading", 1);
  EXPECT_TRUE(downloadIsEnabled(false));
  thePhone()({"key", "Escape"});
  ASSERT_TRUE(comes("Files from"));
  EXPECT_TRUE(cellIs("One.txt", "downloading"));
  EXPECT_TRUE(cellIs("Two.txt", "downloading"));
  EXPECT_TRUE(downloadIsEnabled(false));
}

TEST_F(DownloadSignals, ForUnknownAddressesChangeNothing) {
  for (const char* address : {"", "http://127.0.0.1:9/nowhere", "%s%n", "\xc3\xa9 '\"<b>"}) {
    thePhone()({"signal", "file_downloading", address});
  }
  expectAlive();
}

TEST_F(DownloadSignals, OfOtherTypesAreLoggedAndIgnored) {
  emit("file_downloading", {});
  emit("file_downloading", {"42"});
  emit("file_downloading", {"['" + url(0) + "']"});
  emit("file_downloading", {"'" + url(0) + "'", "'more'"});
  EXPECT_TRUE(waitFor([] {
    return thePhone().log().find("file_downloading with a body of type (ss) is ignored") !=
           std::string::npos;
  })) << thePhone().log();
  emit("file_vanished", {"'" + url(0) + "'"});
  expectAlive();
}

TEST_F(DownloadSignals, InABurstOfTenThousandLeaveThePageUsable) {
  constexpr int kSignals = 10000;
  const std::string one = url(0);  // asks the phone, which takes its time
  SystemBus bus;
  for (int i = 0; i < kSignals; i++) {
    bus.tell(i % 2 ? "file_downloaded" : "file_downloading",
             i % 3 ? "http://127.0.0.1:9/" + std::to_string(i) : one);
  }
  bus.tell("file_downloading", one);
  ASSERT_TRUE(bus.flush());
  EXPECT_TRUE(cellIs("One.txt", "downloading"));
  tell("file_downloaded", 1);
  EXPECT_TRUE(cellIs("Two.txt", "downloaded"));
  thePhone()({"tap", "Download"});
  EXPECT_TRUE(comes("Done"));
}
