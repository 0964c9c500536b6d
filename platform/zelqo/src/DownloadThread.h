/// A downloader with a thread and a main loop to itself: a page is drawn while its pictures are
/// received and written, and neither waits for the other.
#pragma once

#include <common/Owned.h>

#include "Downloader.h"

namespace zelqo {

class DownloadThread {
 public:
  /// Of the process; null, with a log line, when there is no thread to be had.
  static DownloadThread* instance();

  /// What comes is reported from the application's main loop, a few pictures at a time.
  void add(Downloader::Order order);

 private:
  DownloadThread();
  /// Ends what is under way.
  ~DownloadThread();
  DownloadThread(const DownloadThread&) = delete;
  DownloadThread& operator=(const DownloadThread&) = delete;

  static gpointer run(gpointer self);
  static gboolean handOverCb(gpointer self);
  void gather(std::function<void()> report);

  const common::Owned<GMainContext, g_main_context_unref> _context;
  const common::Owned<GMainLoop, g_main_loop_unref> _loop;
  // The thread's own:
  Downloader* _downloader = nullptr;
  std::vector<std::function<void()>> _reports;
  SourceOwner _handOver;
  // The application's:
  GThread* _thread;
};

}  // namespace zelqo
