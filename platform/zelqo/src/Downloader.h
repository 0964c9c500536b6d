/// Fetches pictures: a queue, a few at a time, again after a break when it looks worth it.
#pragma once

#include <list>
#include <set>
#include <string>
#include <vector>

#include "HttpFetch.h"
#include "zelqo.h"

namespace zelqo {

class PictureFile;

class Downloader {
 public:
  struct Options {
    int connections = 6;
    guint inactivityS = 15;
    HttpFetch::Limits limits;
    int retries = 3;
    guint firstPauseMs = 500;  ///< doubles with every retry
  };
  struct Order {
    std::vector<std::string> urls;
    std::string folder;
    zelqo_download_cb callback = nullptr;
    void* userData = nullptr;
  };

  explicit Downloader(const Options& options);
  ~Downloader();
  Downloader(const Downloader&) = delete;
  Downloader& operator=(const Downloader&) = delete;

  static Downloader& instance();

  /// Callbacks come later, from the main loop.
  void add(Order order);

 private:
  struct Batch;
  struct Job;
  struct Transfer;

  static gboolean pumpCb(gpointer self);
  static gboolean retryCb(gpointer job);
  void schedulePump();
  void pump();
  void start(Job job);
  void transferred(Transfer& transfer, const HttpFetch::Outcome& outcome);
  void retryLater(Job job);
  static void report(const Job& job, int error, const char* path);

  const Options _options;
  SessionOwner _session;
  std::list<Job> _waiting;
  std::list<Transfer> _active;
  std::list<Job> _pausing;  ///< each with its timer
  std::set<std::string> _cleaned;
  unsigned int _lastRequest = 0;
  guint _pump = 0;
};

}  // namespace zelqo
