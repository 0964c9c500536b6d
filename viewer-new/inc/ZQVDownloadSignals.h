#pragma once

#include <gio/gio.h>
#include <stdint.h>

#include <functional>

#include "ZQVTimer.h"

/// What the download application tells about its progress on the system bus.
class ZQVDownloadSignals {
 public:
  /// `member` is the signal's name, `url` the download address of the file it is about. Called on
  /// the main loop; the texts are valid during the call.
  using Handler = std::function<void(const char* member, const char* url)>;

  ZQVDownloadSignals() = default;
  ~ZQVDownloadSignals() { stop(); }
  ZQVDownloadSignals(const ZQVDownloadSignals&) = delete;
  ZQVDownloadSignals& operator=(const ZQVDownloadSignals&) = delete;

  /// Follows the signals until stop(); without a system bus it logs and nothing ever arrives. When
  /// the bus goes, it waits for it to come back.
  void start(Handler handler);
  void stop();

  /// The download status that a signal announces: downloading, downloaded, else not downloaded.
  static int32_t statusOf(const char* member);

 private:
  static void _signalCb(GDBusConnection* bus, const gchar* sender, const gchar* path,
                        const gchar* interface, const gchar* member, GVariant* parameters,
                        gpointer data);
  static void _closedCb(GDBusConnection* bus, gboolean vanished, GError* error, gpointer data);
  bool _connect(GError** error);
  void _disconnect();
  bool _reconnect();
  guint _subscribe(const char* member);
  void _unsubscribe(guint& subscription);

  GDBusConnection* _bus = nullptr;
  gulong _closed = 0;
  guint _downloading = 0;
  guint _downloaded = 0;
  Handler _handler;
  ZQVTimer _again;
};
