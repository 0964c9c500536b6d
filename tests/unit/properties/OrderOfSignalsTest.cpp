#include <gio/gio.h>

#include <cstdlib>

#include "../views/ViewTest.h"
#include "ZQVOwned.h"
#include "ZQVReceiverView.h"

#include <rapidcheck.h>

namespace {

constexpr const char* kInterface = "org.tizen.call.remote.share";
constexpr const char* kPath = "/com/orlant/remoteshare";
/// As many as are in the grid at once.
constexpr int kMostFiles = 19;

using Bus = ZQVOwned<GDBusConnection, g_object_unref>;

struct Signal {
  std::string member;
  std::string address;
  bool hasAddressOnly;
};

std::ostream& operator<<(std::ostream& out, const Signal& signal) {
  return out << signal.member << (signal.hasAddressOnly ? " " : " (with more) ") << signal.address;
}

/// The rules: who has which status after a signal.
void follow(const Signal& signal, const Items& files, std::vector<int>* statuses) {
  const bool isDownloading = signal.member == "file_downloading";
  if (!signal.hasAddressOnly || (!isDownloading && signal.member != "file_downloaded")) return;
  const int status = isDownloading ? 2 : 3;
  for (size_t i = 0; i < files.size(); ++i) {
    if (signal.address != files[i].downloadUrl) continue;
    (*statuses)[i] = status;
    return;
  }
}

rc::Gen<Signal> signals() {
  const auto member = rc::gen::elementOf(std::vector<std::string>{
      "file_downloading", "file_downloaded", "file_failed", "file_deleted"});
  const auto address = rc::gen::map(rc::gen::inRange(0, kMostFiles), [](int number) {
    return "http://s/" + std::to_string(number);
  });
  return rc::gen::construct<Signal>(member, address,
                                    rc::gen::weightedElement<bool>({{9, true}, {1, false}}));
}

/// The receiver's page, and the download application on the other end of the bus.
class OrderOfSignals : public ViewTest {
 protected:
  OrderOfSignals() {
    const auto flags =
        static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                          G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION);
    _application = Bus(g_dbus_connection_new_for_address_sync(getenv("DBUS_SYSTEM_BUS_ADDRESS"),
                                                              flags, nullptr, nullptr, nullptr));
    _viewer = Bus(g_bus_get_sync(G_BUS_TYPE_SYSTEM, nullptr, nullptr));
    _end =
        g_dbus_connection_signal_subscribe(_viewer.get(), nullptr, kInterface, "end", kPath,
                                           nullptr, G_DBUS_SIGNAL_FLAGS_NONE, endCb, this, nullptr);
  }
  ~OrderOfSignals() override { g_dbus_connection_signal_unsubscribe(_viewer.get(), _end); }

  void emit(const Signal& signal) {
    GVariant* body = signal.hasAddressOnly ? g_variant_new("(s)", signal.address.c_str())
                                           : g_variant_new("(ss)", signal.address.c_str(), "more");
    g_dbus_connection_emit_signal(_application.get(), nullptr, kPath, kInterface,
                                  signal.member.c_str(), body, nullptr);
  }

  /// The bus answers in order: afterwards it knows what the viewer wants to hear.
  void waitUntilHeard() {
    const ZQVOwned<GVariant, g_variant_unref> answer(g_dbus_connection_call_sync(
        _viewer.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
        "GetId", nullptr, nullptr, G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
  }

  /// Signals arrive in the order in which they were sent.
  bool waitForAll() {
    _ended = false;
    emit({"end", "", true});
    return waitUntil([this] { return _ended; });
  }

  static bool isDownloadEnabled(ZQVReceiverView* view) {
    return isEnabled(elm_object_item_part_content_get(view->getNaviItem(), "toolbar"));
  }

 private:
  static void endCb(GDBusConnection*, const char*, const char*, const char*, const char*, GVariant*,
                    void* self) {
    static_cast<OrderOfSignals*>(self)->_ended = true;
  }

  Bus _application;
  Bus _viewer;
  guint _end = 0;
  bool _ended = false;
};

}  // namespace

TEST_F(OrderOfSignals, LeavesStatusAndButtonAsTheRulesSay) {
  EXPECT_TRUE(rc::check([this] {
    auto statuses =
        *rc::gen::resize(kMostFiles, rc::gen::container<std::vector<int>>(rc::gen::inRange(0, 4)));
    RC_PRE(statuses.size() <= static_cast<size_t>(kMostFiles));
    Items files;
    for (const int status : statuses) {
      ZQViewerThumbnailItem& file = files.add("a.jpg", 1);
      file.downloadStatus = status;
      // Some files have the same address.
      replaceText(&file.downloadUrl,
                  ("http://s/" + std::to_string(*rc::gen::inRange(0, kMostFiles))).c_str());
    }
    auto* view = new ZQVReceiverView(files.list(), false, 1, 1, "Anna", "token");
    naviframe.push(view);
    waitUntilHeard();
    for (const Signal& signal : *rc::gen::container<std::vector<Signal>>(signals())) {
      emit(signal);
      follow(signal, files, &statuses);
    }
    const bool arrived = waitForAll();
    bool any = false;
    for (const int status : statuses) any = any || status == 0 || status == 3;
    const bool enabled = isDownloadEnabled(view);
    naviframe.destroyAllViewControllers();
    RC_ASSERT(arrived);
    for (size_t i = 0; i < statuses.size(); ++i) {
      RC_ASSERT(files[i].downloadStatus == statuses[i]);
    }
    RC_ASSERT(enabled == any);
  }));
}
