/// Fetches pictures: a queue, a few at a time, again after a break when it looks worth it.
#pragma once

#include <functional>
#include <list>
#include <set>
#include <string>
#include <vector>

#include "HttpFetch.h"
#include "Loop.h"
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
  /// What has become of one address of an order.
  struct Report {
    unsigned int requestId;
    int error;
    std::string path;  ///< of the picture; empty with an error
    std::string url;
    unsigned int remaining;
  };
  struct Order {
    std::vector<std::string> urls;
    std::string folder;
    std::function<void(const Report&)> report;
  };

  explicit Downloader(const Options& options);
  ~Downloader();
  Downloader(const Downloader&) = delete;
  Downloader& operator=(const Downloader&) = delete;

  /// Reports come later, from the main loop of the calling thread.
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
  static void report(const Job& job, int error, const std::string& path = {});

  const Options _options;
  SessionOwner _session;
  std::list<Job> _waiting;
  std::list<Transfer> _active;
  std::list<Job> _pausing;  ///< each with its timer
  std::set<std::string> _cleaned;
  unsigned int _lastRequest = 0;
  SourceOwner _pump;
};

}  // namespace zelqo
